#include "UpdateManager.h"
#include "UpdaterLog.h"

#include <cerrno>
#include <cstdio>
#include <system_error>
#include <sys/wait.h>

namespace {

std::string lastSystemError()
{
    return std::generic_category().message(errno);
}

// Turns the status that pclose reports into the exit code callers read.
// Anything but a normal exit is a failure: a command killed by a signal or an
// exit status that cannot be collected must never read as success.
int exitCodeOf(int status, const std::string &command)
{
    if (status == -1) {
        UPDATER_LOG("Could not collect the exit status of: ", command, " (", lastSystemError(), ")");
        return -1;
    }
    if (WIFSIGNALED(status)) {
        UPDATER_LOG("Command ended by signal ", WTERMSIG(status));
        return 128 + WTERMSIG(status);
    }
    return WEXITSTATUS(status);
}

} // namespace

int UpdateManager::runProcess(const std::string &command, std::string &output)
{
    output.clear();
    UPDATER_LOG("Running command: ", command);

    FILE *pipe = popen(command.c_str(), "r");
    if (!pipe) {
        UPDATER_LOG("Could not start command: ", command, " (", lastSystemError(), ")");
        return -1;
    }

    // Read in blocks rather than lines, so that whatever the command prints
    // (binary bytes included) arrives unchanged.
    char buffer[1024];
    for (std::size_t count; (count = std::fread(buffer, 1, sizeof buffer, pipe)) > 0;)
        output.append(buffer, count);

    const int exitCode = exitCodeOf(pclose(pipe), command);
    UPDATER_LOG("Exit code:", exitCode);
    return exitCode;
}
