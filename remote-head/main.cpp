#include "RemoteOutcome.h"
#include "UpdateManager.h"

#include <csignal>
#include <cstring>
#include <iostream>
#include <unistd.h>
#include <vector>

// The remote head's updater. The engine reports through plain function
// pointers, so the outcome lives in file-scope state that the callbacks fill
// in on this (the only) thread.

namespace {

RemoteOutcome gOutcome = RemoteOutcome::NotReported;
volatile std::sig_atomic_t gOutcomeStatus = 0;

void onResult(UpdateManager::Result result)
{
    gOutcome = outcomeOf(result);
}

void onError(UpdateManager::Error error)
{
    gOutcome = outcomeOf(error);
}

void onUpdateFound(std::vector<UpdateManager::UpdateComponent>)
{
    // Remote-head mode installs without offering; an offer leaves the outcome
    // unreported.
}

// The wind-down ends with "systemctl stop druv-updater", which stops this
// very program when it runs as that service. By then the outcome is known, so
// the stop becomes an ordinary exit with the outcome's status.
void exitWithOutcome(int)
{
    _exit(gOutcomeStatus);
}

void exitWithOutcomeWhenStopped(int status)
{
    gOutcomeStatus = status;
    struct sigaction action {};
    action.sa_handler = exitWithOutcome;
    sigemptyset(&action.sa_mask);
    sigaction(SIGTERM, &action, nullptr);
}

} // namespace

int main(int argc, char *argv[])
{
    if (argc == 2 && (std::strcmp(argv[1], "--help") == 0 || std::strcmp(argv[1], "-h") == 0)) {
        printUsage(std::cout, argv[0]);
        return 0;
    }
    if (argc > 1) {
        std::cerr << argv[0] << ": unknown argument '" << argv[1] << "'\n";
        printUsage(std::cerr, argv[0]);
        return kUsageErrorStatus;
    }

    UpdateManager *engine = UpdateManager::instance();
    engine->setCallbacks(onResult, onError, onUpdateFound);
    engine->init(true);
    engine->update({}, true);

    const int status = exitStatusOf(gOutcome);
    std::cout << "QuarnRemoteUpdater: " << describe(gOutcome) << " (exit status " << status << ")" << std::endl;
    exitWithOutcomeWhenStopped(status);
    engine->deinit(true);
    return status;
}
