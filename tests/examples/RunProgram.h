/// \file
/// Runs the programs of the system that serve tests as oracles.
#pragma once
#include <string>
#include <vector>

namespace test {

/// Runs a program found on the path, its standard and error output thrown away.
/// \returns its exit code; -1 if it could not be started or was ended by a signal. A program that
///     does not exist may also give 127.
int runProgram(std::vector<std::string> arguments);

/// The standard output of a program found on the path.
/// \throws std::runtime_error  if it could not be started or failed.
std::string outputOf(std::vector<std::string> arguments);

}  // namespace test
