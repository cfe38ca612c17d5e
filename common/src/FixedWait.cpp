#include "FixedWait.h"

#include <atomic>
#include <cerrno>
#include <ctime>

namespace FixedWait {

namespace {

std::atomic<Sleeper> installedSleeper{&sleepWhole};

timespec deadlineAfter(std::chrono::nanoseconds duration)
{
    timespec deadline{};
    clock_gettime(CLOCK_MONOTONIC, &deadline);
    const long long nanoseconds = deadline.tv_nsec + duration.count() % 1'000'000'000;
    deadline.tv_sec += static_cast<time_t>(duration.count() / 1'000'000'000 + nanoseconds / 1'000'000'000);
    deadline.tv_nsec = static_cast<long>(nanoseconds % 1'000'000'000);
    return deadline;
}

} // namespace

void waitFor(std::chrono::seconds duration)
{
    installedSleeper.load()(duration);
}

Sleeper setSleeper(Sleeper sleeper)
{
    return installedSleeper.exchange(sleeper ? sleeper : &sleepWhole);
}

void sleepWhole(std::chrono::seconds duration)
{
#ifdef UPDATER_SHORT_WAITS
    // The simulated module reboots in seconds, not minutes; a hundredth of
    // every wait keeps the order of events while a run stays short.
    sleepUninterrupted(std::chrono::duration_cast<std::chrono::nanoseconds>(duration) / 100);
#else
    sleepUninterrupted(duration);
#endif
}

void sleepUninterrupted(std::chrono::nanoseconds duration)
{
    // An absolute deadline on the monotonic clock: a signal that interrupts
    // the sleep neither shortens it nor lets rounding errors pile up.
    const timespec deadline = deadlineAfter(duration);
    while (clock_nanosleep(CLOCK_MONOTONIC, TIMER_ABSTIME, &deadline, nullptr) == EINTR) {
    }
}

} // namespace FixedWait
