/// \file
/// The registry starts once and whole, whichever way threads come to it first.
///
/// A process has one first use only, so each round is a process of its own.
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

/// Runs the helper with one argument; its exit code, or -1 if it did not exit by itself.
int runHelper(std::string argument)
{
    std::string program = TARNKILN_REGISTRY_FIRST_USE;
    char* const arguments[] = {program.data(), argument.data(), nullptr};
    pid_t child = 0;
    if (posix_spawn(&child, program.c_str(), nullptr, nullptr, arguments, environ) != 0)
        return -1;
    int status = 0;
    if (waitpid(child, &status, 0) != child || !WIFEXITED(status))
        return -1;
    return WEXITSTATUS(status);
}

class RegistryFirstUse : public ::testing::TestWithParam<char const*>
{};

TEST_P(RegistryFirstUse, IsSafeFromEightThreadsAtOnce)
{
    constexpr int ROUNDS = 10;
    for (int round = 0; round < ROUNDS; ++round)
        ASSERT_EQ(runHelper(GetParam()), 0) << "in round " << round;
}

INSTANTIATE_TEST_SUITE_P(From, RegistryFirstUse,
                         ::testing::Values("registry", "modelClass", "modelElementClass",
                                           "constellationClass", "integralType", "commitMessage",
                                           "modelsMetaClass", "all"),
                         [](auto const& info) { return std::string(info.param); });

TEST(RegistryFirstUseHelper, RefusesAnUnknownEntryPoint)
{
    EXPECT_EQ(runHelper("noSuchEntryPoint"), 2);
}
}  // namespace
