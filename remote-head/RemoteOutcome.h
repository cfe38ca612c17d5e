#pragma once

#include "UpdateManager.h"

#include <ostream>

// How one remote-head run ended: in words for the person at the instrument,
// and as the program's exit status for the scripts and the service manager
// that start it. Every outcome has a status of its own.
enum class RemoteOutcome {
    UpdateFinished,
    NoUpdates,
    CheckUpdateFailed,
    UpdateMirrorsFailed,
    UpdateFailed,
    UpdateVexaFailed,
    NotReported,
};

// A call of the program that it cannot understand (EX_USAGE of sysexits.h).
constexpr int kUsageErrorStatus = 64;

RemoteOutcome outcomeOf(UpdateManager::Result result);
RemoteOutcome outcomeOf(UpdateManager::Error error);

int exitStatusOf(RemoteOutcome outcome);
const char *describe(RemoteOutcome outcome);

// The --help text: what a run does to the instrument and every exit status.
void printUsage(std::ostream &out, const char *programName);
