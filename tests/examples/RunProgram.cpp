#include "tests/examples/RunProgram.h"

#include <array>
#include <cerrno>
#include <fcntl.h>
#include <spawn.h>
#include <stdexcept>
#include <sys/wait.h>
#include <unistd.h>

namespace test {
namespace {

/// Starts the program with `output` as standard output; 0 if that fails.
pid_t start(std::vector<std::string>& arguments, int output)
{
    std::vector<char*> pointers;
    for (std::string& argument : arguments)
        pointers.push_back(argument.data());
    pointers.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    if (output < 0)
        posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
    else
        posix_spawn_file_actions_adddup2(&actions, output, STDOUT_FILENO);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);

    pid_t process = 0;
    int const failure =
        posix_spawnp(&process, pointers[0], &actions, nullptr, pointers.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    return failure == 0 ? process : 0;
}

int waitFor(pid_t process)
{
    int status = 0;
    while (waitpid(process, &status, 0) < 0)
    {
        if (errno != EINTR)
            return -1;
    }
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

}  // namespace

int runProgram(std::vector<std::string> arguments)
{
    pid_t const process = start(arguments, /*output=*/-1);
    return process == 0 ? -1 : waitFor(process);
}

std::string outputOf(std::vector<std::string> arguments)
{
    std::array<int, 2> ends{};
    if (pipe2(ends.data(), O_CLOEXEC) != 0)
        throw std::runtime_error("no pipe");
    pid_t const process = start(arguments, ends[1]);
    close(ends[1]);

    std::string output;
    std::array<char, 4096> block{};
    for (ssize_t count; (count = read(ends[0], block.data(), block.size())) > 0;)
        output.append(block.data(), static_cast<std::size_t>(count));
    close(ends[0]);
    if (process == 0 || waitFor(process) != 0)
        throw std::runtime_error(arguments.front() + " failed");
    return output;
}

}  // namespace test
