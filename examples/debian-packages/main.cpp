/// \file
/// Reads the packages of a Debian system into a model and shows what transactions do.
#include "CommandLine.h"
#include "Demonstration.h"
#include "reader/ReadError.h"

#include <cstdlib>
#include <exception>
#include <iostream>
#include <string>
#include <unistd.h>
#include <vector>

namespace {

template <debian::ElementForm Form> bool run(debian::CommandLine const& commandLine)
{
    debian::Demonstration<Form> demonstration(std::cout, std::cerr, isatty(STDERR_FILENO) != 0);
    bool const equal = demonstration.run(commandLine);
    if (commandLine.figures)
        demonstration.figures().write(*commandLine.figures);
    else
    {
        std::cout << "\nFigures\n";
        demonstration.figures().print(std::cout);
    }
    return equal;
}

}  // namespace

int main(int argumentCount, char** arguments)
{
    constexpr int USAGE_ERROR = 2;
    try
    {
        auto const commandLine = debian::parseCommandLine(
            std::vector<std::string>(arguments + 1, arguments + argumentCount));
        if (commandLine.wantsHelp)
        {
            std::cout << debian::helpText();
            return EXIT_SUCCESS;
        }
        bool const equal = commandLine.reflective ? run<debian::Reflective>(commandLine)
                                                  : run<debian::Generated>(commandLine);
        return equal ? EXIT_SUCCESS : EXIT_FAILURE;
    }
    catch (debian::UsageError const& error)
    {
        std::cerr << "debian-packages: " << error.what() << "\nTry debian-packages --help\n";
        return USAGE_ERROR;
    }
    catch (std::exception const& error)
    {
        std::cerr << "debian-packages: " << error.what() << '\n';
        return EXIT_FAILURE;
    }
}
