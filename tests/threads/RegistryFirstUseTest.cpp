/// \file
/// The registry and its catalogue are made once and whole, whichever way threads come to them
/// first.
///
/// A process has one first use only, so each round is a process of its own.
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

/// Runs the helper; its exit code, or -1 if it did not exit by itself.
int runHelper(std::vector<std::string> words)
{
    words.insert(words.begin(), TARNKILN_REGISTRY_FIRST_USE);
    std::vector<char*> arguments;
    for (std::string& word : words)
        arguments.push_back(word.data());
    arguments.push_back(nullptr);
    pid_t child = 0;
    if (posix_spawn(&child, words[0].c_str(), nullptr, nullptr, arguments.data(), environ) != 0)
        return -1;
    int status = 0;
    if (waitpid(child, &status, 0) != child || !WIFEXITED(status))
        return -1;
    return WEXITSTATUS(status);
}

/// How many processes to run; more find more.
int rounds()
{
    char const* const wanted = std::getenv("TARNKILN_FIRST_USE_ROUNDS");
    return wanted ? std::atoi(wanted) : 20;
}

TEST(FirstUse, IsSafeFromEightThreadsAtOnceByEachWayIn)
{
    for (int round = 0; round < rounds(); ++round)
        ASSERT_EQ(runHelper({"round", std::to_string(round)}), 0) << "in round " << round;
}

TEST(FirstUse, IsSafeFromThreadsThatComeByDifferentWays)
{
    for (int round = 0; round < 3; ++round)
        ASSERT_EQ(runHelper({"all"}), 0);
}

TEST(FirstUse, SucceedsAfterAnAttemptThatFailed)
{
    EXPECT_EQ(runHelper({"afterFailure"}), 0);
}

TEST(FirstUseHelper, RefusesAnUnknownEntryPoint)
{
    EXPECT_EQ(runHelper({"noSuchEntryPoint"}), 2);
}
}  // namespace
