#include "RemoteOutcome.h"

namespace {

struct OutcomeEntry
{
    RemoteOutcome outcome;
    int exitStatus;
    const char *words;
};

// The statuses are part of the program's interface: scripts on the remote
// head and the druv-updater unit file may rely on them. 2 stays unused, since
// many callers take it for a usage error.
constexpr OutcomeEntry kOutcomes[] = {
    {RemoteOutcome::UpdateFinished, 0, "update finished: the remote head and the Vexa module are up to date"},
    {RemoteOutcome::NoUpdates, 1, "no updates found"},
    {RemoteOutcome::CheckUpdateFailed, 3,
     "checking for updates failed: a version of the remote head's package or of the module could not be read"},
    {RemoteOutcome::UpdateMirrorsFailed, 4, "checking for updates failed: the package index on the USB drive could not be read"},
    {RemoteOutcome::UpdateFailed, 5, "installing the remote head's package failed"},
    {RemoteOutcome::UpdateVexaFailed, 6, "installing the Vexa module failed"},
    {RemoteOutcome::NotReported, 7, "the update engine reported no outcome"},
};

const OutcomeEntry &entryOf(RemoteOutcome outcome)
{
    for (const OutcomeEntry &entry : kOutcomes) {
        if (entry.outcome == outcome)
            return entry;
    }
    return kOutcomes[sizeof kOutcomes / sizeof kOutcomes[0] - 1];
}

} // namespace

RemoteOutcome outcomeOf(UpdateManager::Result result)
{
    return result == UpdateManager::UpdateFinished ? RemoteOutcome::UpdateFinished : RemoteOutcome::NoUpdates;
}

RemoteOutcome outcomeOf(UpdateManager::Error error)
{
    switch (error) {
    case UpdateManager::CheckUpdateFailed:
        return RemoteOutcome::CheckUpdateFailed;
    case UpdateManager::UpdateMirrorsFailed:
        return RemoteOutcome::UpdateMirrorsFailed;
    case UpdateManager::UpdateFailed:
        return RemoteOutcome::UpdateFailed;
    case UpdateManager::UpdateVexaFailed:
        return RemoteOutcome::UpdateVexaFailed;
    }
    return RemoteOutcome::NotReported;
}

int exitStatusOf(RemoteOutcome outcome)
{
    return entryOf(outcome).exitStatus;
}

const char *describe(RemoteOutcome outcome)
{
    return entryOf(outcome).words;
}

void printUsage(std::ostream &out, const char *programName)
{
    out << "Usage: " << programName << " [--help]\n"
        << "\n"
        << "Updates the remote head of the instrument and its Vexa module from the USB drive\n"
        << "mounted at /root/USB_MOUNT/, in one run and without asking:\n"
        << "  1. stops the instrument service druv;\n"
        << "  2. refreshes the package index (apt update), installs a differing version of\n"
        << "     marlix4-rh and, when the drive carries other module software, uploads it to\n"
        << "     the module at 192.168.9.2, runs its install script and waits for the module;\n"
        << "  3. prints the outcome in words, then unmounts the drive, starts druv again and\n"
        << "     stops the service druv-updater.\n"
        << "The engine's log of every step goes to standard output.\n"
        << "\n"
        << "Exit status:\n";
    for (const OutcomeEntry &entry : kOutcomes)
        out << "  " << entry.exitStatus << "  " << entry.words << "\n";
    out << " " << kUsageErrorStatus << "  usage error: an option or argument this program does not know\n"
        << "\n"
        << "Run as the service druv-updater, the program is ended by the stop of that service at\n"
        << "the end of the wind-down; it then exits with the status of the outcome above instead\n"
        << "of dying of the signal. Run from a shell, it exits with the same status once the\n"
        << "wind-down has returned. A stop before the outcome is known ends it as usual, with\n"
        << "status 143.\n";
}
