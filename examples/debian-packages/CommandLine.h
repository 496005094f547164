/// \file
/// What the user asks of the program.
#pragma once
#include "Question.h"

#include <cstddef>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace debian {

/// The arguments make no sense; `what()` says why.
class UsageError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

struct CommandLine
{
    static std::string const STANDARD_INPUT;  ///< "-"

    std::string file = "/var/lib/dpkg/status";
    std::optional<std::string> available;
    std::vector<Question> questions;     ///< In the order given; without any all is shown.
    std::size_t maxRows = 10;            ///< Of one answer; 0 for all.
    bool reflective = false;             ///< Elements of classes that are defined at run time.
    std::optional<std::string> figures;  ///< Where the figures go; else they are printed.
    bool wantsHelp = false;
};

/// Reads the arguments, the name of the program not among them.
///
/// \throws UsageError  for an unknown option, one without its value, a third file, and standard
/// input given twice, and a number of rows that is none.
CommandLine parseCommandLine(std::vector<std::string> const& arguments);

/// What `--help` prints.
std::string const& helpText();

}  // namespace debian
