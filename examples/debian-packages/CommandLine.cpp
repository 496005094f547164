#include "CommandLine.h"

namespace debian {

std::string const CommandLine::STANDARD_INPUT = "-";

CommandLine parseCommandLine(std::vector<std::string> const& arguments)
{
    CommandLine result;
    std::vector<std::string> files;
    bool optionsEnded = false;
    for (auto argument = arguments.begin(); argument != arguments.end(); ++argument)
    {
        bool const isOption =
            !optionsEnded && argument->starts_with('-') && *argument != CommandLine::STANDARD_INPUT;
        if (!isOption)
            files.push_back(*argument);
        else if (*argument == "--")
            optionsEnded = true;
        else if (*argument == "--help" || *argument == "-h")
            result.wantsHelp = true;
        else if (*argument == "--reflective")
            result.reflective = true;
        else if (*argument != "--figures")
            throw UsageError("unknown option: " + *argument);
        else if (++argument == arguments.end())
            throw UsageError("--figures needs the name of a file");
        else
            result.figures = *argument;
    }
    if (files.size() > 2)
        throw UsageError("more than two files: " + files[2]);
    if (!files.empty())
        result.file = files[0];
    if (files.size() > 1)
        result.available = files[1];
    if (result.file == CommandLine::STANDARD_INPUT && result.available == result.file)
        throw UsageError("standard input can be read only once");
    return result;
}

std::string const& helpText()
{
    static std::string const text =
        "Usage: debian-packages [OPTION]... [FILE [AVAILABLE]]\n"
        "\n"
        "Reads the Debian package index FILE into a model (- is standard input; by default\n"
        "/var/lib/dpkg/status), changes it in transactions, and takes the changes back. FILE is "
        "not\n"
        "changed. Dependencies that FILE does not hold are looked up in the index AVAILABLE, such "
        "as\n"
        "the output of apt-cache dumpavail.\n"
        "\n"
        "      --reflective    has classes that are defined at run time, not generated ones\n"
        "      --figures FILE  writes the figures to FILE, name and value parted by a tabulator\n"
        "  -h, --help          prints this text\n"
        "\n"
        "Exit status: 0 if all went well, 1 if a file can not be read or is malformed, 2 if the\n"
        "arguments make no sense.\n";
    return text;
}

}  // namespace debian
