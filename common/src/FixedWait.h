#pragma once

#include <chrono>

// Every fixed pause of the engine (the module's reboot after its install
// script, the service's start-up before the updater stops itself) passes
// through here, so that tests can see which durations were asked for
// without waiting for them.
namespace FixedWait {

// How long the Vexa module needs to unpack its archive and reboot after its
// install script has been started.
inline constexpr std::chrono::seconds kModuleInstallWait{780};

// How long the instrument service needs to come up before the updater's own
// service may be stopped (that stop ends the updater).
inline constexpr std::chrono::seconds kServiceStartWait{10};

// Pause between two reads of a module that may still be rebooting.
inline constexpr std::chrono::seconds kModuleVerifyPause{5};

using Sleeper = void (*)(std::chrono::seconds duration);

// Waits `duration` through the installed sleeper.
void waitFor(std::chrono::seconds duration);

// Installs another sleeper and returns the one it replaces; nullptr restores
// the default.
Sleeper setSleeper(Sleeper sleeper);

// The default sleeper: sleeps the whole duration, resuming after every
// interruption by a signal. Simulator builds shorten it to a hundredth.
void sleepWhole(std::chrono::seconds duration);

// Sleeps exactly `duration`, resuming after every interruption by a signal.
void sleepUninterrupted(std::chrono::nanoseconds duration);

} // namespace FixedWait
