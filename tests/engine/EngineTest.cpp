#include "EngineTest.h"

#include <chrono>
#include <condition_variable>
#include <cstdio>
#include <cstdlib>
#include <fnmatch.h>
#include <fstream>
#include <iostream>
#include <mutex>
#include <regex>

namespace {

constexpr auto kGenerousWait = std::chrono::seconds(60);

// Takes the engine's log in place of standard output. With no put area every
// character passes the locked overrides, so a test may read while a worker writes.
struct LogCapture : std::streambuf
{
    std::mutex mutex;
    std::string text;

    int_type overflow(int_type c) override
    {
        const char character = traits_type::to_char_type(c);
        return c == traits_type::eof() ? 0 : (xsputn(&character, 1), c);
    }
    std::streamsize xsputn(const char *s, std::streamsize count) override
    {
        const std::lock_guard<std::mutex> lock(mutex);
        text.append(s, static_cast<std::size_t>(count));
        return count;
    }
};

// Installed before the engine first writes and never swapped back, since a
// worker may still hold the stream.
LogCapture &capture()
{
    static LogCapture *const installed = [] {
        auto *logCapture = new LogCapture;
        std::cout.rdbuf(logCapture);
        return logCapture;
    }();
    return *installed;
}

struct Recorder
{
    std::mutex mutex;
    std::condition_variable changed;
    std::vector<Outcome> outcomes;
    std::vector<long> waits;
    std::string journal;
    bool holding = false;
} recorder;

void record(std::string text)
{
    std::unique_lock<std::mutex> lock(recorder.mutex);
    recorder.outcomes.push_back({std::move(text), std::this_thread::get_id()});
    recorder.changed.notify_all();
    recorder.changed.wait(lock, [] { return !recorder.holding; });
}

const char *const kResults[] = {"NoUpdates", "UpdateFinished"};
const char *const kErrors[] = {"CheckUpdateFailed", "UpdateMirrorsFailed", "UpdateFailed", "UpdateVexaFailed"};

void onResult(UpdateManager::Result result) { record(kResults[result]); }
void onError(UpdateManager::Error error) { record(kErrors[error]); }

void onUpdateFound(std::vector<Component> list)
{
    std::string text = "UpdateFound:";
    for (const Component &c : list)
        text += " " + std::to_string(c.type) + " " + c.name + " " + c.installedVersion + " -> " + c.candidateVersion + ";";
    record(text);
}

void journalWait(std::chrono::seconds duration)
{
    const std::lock_guard<std::mutex> lock(recorder.mutex);
    recorder.waits.push_back(static_cast<long>(duration.count()));
    std::ofstream(recorder.journal, std::ios::app) << "sleep " << duration.count() << '\n';
}

[[noreturn]] void abandonRun(const char *missing)
{
    const std::lock_guard<std::mutex> lock(capture().mutex);
    std::fprintf(stderr, "%s never came; engine log:\n%s\n", missing, capture().text.c_str());
    std::abort();
}

} // namespace

void EngineTest::SetUp()
{
    capture();
    {
        const std::lock_guard<std::mutex> lock(recorder.mutex);
        recorder.outcomes.clear();
        recorder.waits.clear();
        recorder.journal = fake.scenarioDir() + "/journal";
        recorder.holding = false;
    }
    mPreviousSleeper = FixedWait::setSleeper(&journalWait);
    engine.setCallbacks(&onResult, &onError, &onUpdateFound);
    const std::lock_guard<std::mutex> lock(capture().mutex);
    capture().text.clear();
}

void EngineTest::TearDown()
{
    FixedWait::setSleeper(mPreviousSleeper);
    if (HasFailure())
        std::fprintf(stderr, "Engine log:\n%s\n", log().c_str());
}

void EngineTest::script(int mirrorsStatus, Package package, Module module)
{
    fake.answer("apt update", "Reading package lists... Done\n", mirrorsStatus);
    const bool packageDue = package == Package::Due || package == Package::InstallFails;
    fake.answer("apt-cache policy *", package == Package::QueryFails ? ""
                                      : "  Installed: 1.4.2\n  Candidate: " + std::string(packageDue ? "1.5.0\n" : "1.4.2\n"));
    fake.answer("apt --assume-yes install *", "E: Unable to fetch\n", package == Package::InstallFails ? 100 : 0);
    // The module ends its version line the DOS way; once installed it reports 2.0.
    if (module == Module::Unreachable)
        fake.answer(kModuleVersionRead, "", 255);
    if (module == Module::Due)
        fake.answer(kModuleVersionRead, "Quillowmarsh\t1.9\r\n", 0, 1);
    const bool installed = module == Module::UpToDate || module == Module::Due;
    fake.answer(kModuleVersionRead, installed ? "Quillowmarsh\t2.0\r\n" : "Quillowmarsh\t1.9\r\n");
    fake.answer(kModuleListing, "2.0\n");
    fake.answer("scp *", "", module == Module::UploadFails ? 1 : 0);
}

std::vector<Outcome> EngineTest::waitForOutcomes(std::size_t count)
{
    std::unique_lock<std::mutex> lock(recorder.mutex);
    if (!recorder.changed.wait_for(lock, kGenerousWait, [&] { return recorder.outcomes.size() >= count; }))
        abandonRun("An outcome callback");
    return recorder.outcomes;
}

void EngineTest::waitForWindDown()
{
    // The logged status of the updater's own stop is the wind-down's last act.
    const std::regex lastEntry("stopUpdater\\(\\)\n\t\t\t-?[0-9]+\n");
    const auto deadline = std::chrono::steady_clock::now() + kGenerousWait;
    while (!std::regex_search(log(), lastEntry)) {
        if (std::chrono::steady_clock::now() > deadline)
            abandonRun("The end of the wind-down");
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
}

void EngineTest::holdCallbacks(bool hold)
{
    const std::lock_guard<std::mutex> lock(recorder.mutex);
    recorder.holding = hold;
    recorder.changed.notify_all();
}

std::vector<long> EngineTest::waits() const
{
    const std::lock_guard<std::mutex> lock(recorder.mutex);
    return recorder.waits;
}

bool EngineTest::ranInOrder(const std::vector<std::string> &globs) const
{
    auto next = globs.begin();
    for (const std::string &call : fake.journal())
        next += next != globs.end() && fnmatch(next->c_str(), call.c_str(), 0) == 0;
    return next == globs.end();
}

int EngineTest::runs(const std::string &glob) const
{
    int count = 0;
    for (const std::string &call : fake.journal())
        count += fnmatch(glob.c_str(), call.c_str(), 0) == 0;
    return count;
}

void EngineTest::expectJournal(const ScenarioRow &row) const
{
    EXPECT_TRUE(ranInOrder(row.ran)) << testing::PrintToString(fake.journal());
    for (const std::string &glob : row.notRan)
        EXPECT_EQ(runs(glob), 0) << glob;
}

std::string EngineTest::log()
{
    const std::lock_guard<std::mutex> lock(capture().mutex);
    return capture().text;
}

bool EngineTest::logged(const std::string &message)
{
    return log().find("\n\t\t\t" + message + "\n") != std::string::npos;
}
