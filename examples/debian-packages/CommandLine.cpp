#include "CommandLine.h"

#include <algorithm>
#include <charconv>
#include <iterator>
#include <system_error>

namespace debian {

std::string const CommandLine::STANDARD_INPUT = "-";

namespace {

/// An option that asks a question.
struct QuestionOption
{
    char const* name;
    Question::Kind kind;
    char const* argument;  ///< What must follow; null for nothing.
};

constexpr char const* PATTERN = "a pattern";
constexpr QuestionOption QUESTION_OPTIONS[] = {
    {"--unmet", Question::Kind::Unmet, nullptr},
    {"--unmet-recommended", Question::Kind::UnmetRecommended, nullptr},
    {"--same-maintainer", Question::Kind::SameMaintainer, nullptr},
    {"--largest", Question::Kind::Largest, PATTERN},
    {"--reverse", Question::Kind::Reverse, "the name of a package"},
    {"--tag", Question::Kind::Tag, PATTERN},
};

std::size_t toNumberOfRows(std::string const& text)
{
    std::size_t number = 0;
    char const* const end = text.data() + text.size();
    auto const result = std::from_chars(text.data(), end, number);
    if (result.ec != std::errc() || result.ptr != end)
        throw UsageError("no number of rows: " + text);
    return number;
}

/// Goes through the arguments and keeps what they say.
class Parser
{
public:
    explicit Parser(std::vector<std::string> const& arguments)
        : m_next(arguments.begin()),
          m_end(arguments.end())
    {}

    CommandLine parse()
    {
        bool optionsEnded = false;
        while (m_next != m_end)
        {
            std::string const& argument = *m_next++;
            if (optionsEnded || !argument.starts_with('-') ||
                argument == CommandLine::STANDARD_INPUT)
                m_files.push_back(argument);
            else if (argument == "--")
                optionsEnded = true;
            else if (!takeQuestion(argument))
                takeOption(argument);
        }
        takeFiles();
        return m_result;
    }

private:
    /// The argument behind an option, which is `what`.
    std::string const& valueOf(std::string const& option, std::string const& what)
    {
        if (m_next == m_end)
            throw UsageError(option + " needs " + what);
        return *m_next++;
    }

    bool takeQuestion(std::string const& argument)
    {
        auto const option = std::find_if(
            std::begin(QUESTION_OPTIONS), std::end(QUESTION_OPTIONS),
            [&](QuestionOption const& candidate) { return argument == candidate.name; });
        if (option == std::end(QUESTION_OPTIONS))
            return false;
        m_result.questions.push_back(
            {option->kind, option->argument ? valueOf(argument, option->argument) : ""});
        return true;
    }

    void takeOption(std::string const& argument)
    {
        if (argument == "--help" || argument == "-h")
            m_result.wantsHelp = true;
        else if (argument == "--reflective")
            m_result.reflective = true;
        else if (argument == "--figures")
            m_result.figures = valueOf(argument, "the name of a file");
        else if (argument == "--limit")
            m_result.maxRows = toNumberOfRows(valueOf(argument, "a number of rows"));
        else
            throw UsageError("unknown option: " + argument);
    }

    void takeFiles()
    {
        if (m_files.size() > 2)
            throw UsageError("more than two files: " + m_files[2]);
        if (!m_files.empty())
            m_result.file = m_files[0];
        if (m_files.size() > 1)
            m_result.available = m_files[1];
        if (m_result.file == CommandLine::STANDARD_INPUT && m_result.available == m_result.file)
            throw UsageError("standard input can be read only once");
    }

    std::vector<std::string>::const_iterator m_next;
    std::vector<std::string>::const_iterator m_end;
    std::vector<std::string> m_files;
    CommandLine m_result;
};

}  // namespace

CommandLine parseCommandLine(std::vector<std::string> const& arguments)
{
    return Parser(arguments).parse();
}

std::string const& helpText()
{
    static std::string const text =
        "Usage: debian-packages [OPTION]... [FILE [AVAILABLE]]\n"
        "\n"
        "Reads the Debian package index FILE into a model (- is standard input; by default\n"
        "/var/lib/dpkg/status), changes it in transactions, takes the changes back, and asks all\n"
        "questions. FILE is not changed. Dependencies that FILE does not hold are looked up in\n"
        "the index AVAILABLE, such as the output of apt-cache dumpavail.\n"
        "\n"
        "With questions only these are answered, from FILE alone:\n"
        "\n"
        "      --unmet              dependencies that no package of FILE satisfies\n"
        "      --unmet-recommended  recommendations that no package of FILE satisfies\n"
        "      --same-maintainer    packages that depend on one of the same maintainer\n"
        "      --largest PATTERN    the packages whose names match, the largest first\n"
        "      --reverse NAME       dependencies on the package of that name\n"
        "      --tag PATTERN        tags the packages whose names match, finds them by the tag,\n"
        "                           and takes it back\n"
        "\n"
        "A PATTERN is a regular expression that is searched in the name.\n"
        "\n"
        "      --limit NUMBER       shows so many rows of each answer (10; 0 for all)\n"
        "      --reflective         has classes that are defined at run time, not generated ones\n"
        "      --figures FILE       writes the figures to FILE, name and value parted by a\n"
        "                           tabulator\n"
        "  -h, --help               prints this text\n"
        "\n"
        "Exit status: 0 if all went well; 1 if a file can not be read or is malformed, a PATTERN\n"
        "is no regular expression, or FILE does not know NAME; 2 if the arguments make no sense.\n";
    return text;
}

}  // namespace debian
