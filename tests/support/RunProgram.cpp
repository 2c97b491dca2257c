#include "tests/support/RunProgram.h"

#include "tests/support/Files.h"
#include "tests/support/Placeholders.h"

#include <stdexcept>

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

std::string RunWithPlaceholders(const char* program, const TemporaryDirectory& directory,
                                const std::vector<std::string>& arguments)
{
    std::vector<std::string> fullArguments;
    fullArguments.reserve(arguments.size());
    for (const std::string& argument : arguments)
    {
        fullArguments.push_back(ReplaceAll(argument, "@", directory.Path()));
    }
    const ProgramResult result = RunProgram(program, fullArguments);
    const std::string report =
        result.standardOutput + result.standardError + "status " + std::to_string(result.status) + "\n";
    return WithPlaceholders(report, directory);
}

} // namespace

ProgramResult RunProgram(const std::string& program, const std::vector<std::string>& arguments)
{
    const TemporaryDirectory directory;
    const std::string output = directory / "output";
    const std::string error = directory / "error";
    posix_spawn_file_actions_t actions;
    ::posix_spawn_file_actions_init(&actions);
    ::posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, output.c_str(), O_CREAT | O_WRONLY, 0600);
    ::posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, error.c_str(), O_CREAT | O_WRONLY, 0600);

    std::vector<char*> argv = {const_cast<char*>(program.c_str())};
    for (const std::string& argument : arguments)
    {
        argv.push_back(const_cast<char*>(argument.c_str()));
    }
    argv.push_back(nullptr);

    pid_t process = 0;
    const int failure = ::posix_spawnp(&process, program.c_str(), &actions, nullptr, argv.data(), environ);
    ::posix_spawn_file_actions_destroy(&actions);
    if (failure != 0)
    {
        throw std::runtime_error("can't run " + program);
    }
    int status = 0;
    ::waitpid(process, &status, 0);
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status), ReadFile(output), ReadFile(error)};
}

std::string RunPagemeld(const TemporaryDirectory& directory, const std::vector<std::string>& arguments)
{
    return ReplaceAll(RunWithPlaceholders(PAGEMELD_PROGRAM, directory, arguments), PAGEMELD_PROGRAM,
                      "PROGRAM");
}

std::string RunPagemeldCheck(const TemporaryDirectory& directory, const std::vector<std::string>& arguments)
{
    return RunWithPlaceholders(PAGEMELD_CHECK_PROGRAM, directory, arguments);
}
