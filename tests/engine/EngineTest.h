#pragma once

#include "FakeInstrument.h"
#include "FixedWait.h"
#include "UpdateManager.h"

#include <gtest/gtest.h>

#include <fnmatch.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <mutex>
#include <regex>

using Component = UpdateManager::UpdateComponent;
// What the callbacks reported, in words ("UpdateFound: 1 VEXA 1.9 -> 2.0;"), and on which thread.
using Outcomes = std::vector<std::pair<std::string, std::thread::id>>;

// Journal patterns of the commands that reach the Vexa module and the drive.
inline const std::string kVersionRead = "ssh *version.txt*";
inline const std::string kListing = "ls /root/USB_MOUNT/debs/VEXA/armhf/";
inline const std::string kInstallScript = "ssh */unzipUpgrade.sh";
inline const std::string kEveryByte = [] {
    std::string bytes;
    for (int value = 0; value < 256; ++value)
        bytes += static_cast<char>(value);
    return bytes;
}();

inline const char *const kErrorNames[] = {"CheckUpdateFailed", "UpdateMirrorsFailed", "UpdateFailed",
                                          "UpdateVexaFailed"};

// The head's package and the Vexa module as a test scripts them.
enum class Package { QueryFails, UpToDate, Due, InstallFails };
enum class Module { UpToDate, Unreachable, Due, UploadFails, StaysOld };

// Takes the engine's log in place of standard output, before the engine first
// writes and for good (never destroyed), since a worker or the exit's flush may
// still use the stream. With no put area every character passes the locked overrides.
struct LogCapture : std::streambuf
{
    std::mutex mutex;
    std::string text;
    LogCapture() { std::cout.rdbuf(this); }
    int_type overflow(int_type c) override
    {
        const char character = traits_type::to_char_type(c);
        return c == traits_type::eof() ? 0 : (xsputn(&character, 1), c);
    }
    std::streamsize xsputn(const char *s, std::streamsize count) override
    {
        const std::lock_guard<std::mutex> lock(mutex);
        return text.append(s, static_cast<std::size_t>(count)), count;
    }
};
inline LogCapture &logCapture = *new LogCapture;

inline std::mutex recorderMutex, callbackGate;
inline Outcomes recorded;

inline std::string engineLog()
{
    const std::lock_guard<std::mutex> lock(logCapture.mutex);
    return logCapture.text;
}

inline bool logged(const std::string &message)
{
    return engineLog().find("\n\t\t\t" + message + "\n") != std::string::npos;
}

// Each test gets a fresh fake instrument, recording callbacks, a fixed-wait
// seam that journals "sleep N" instead of sleeping, and an empty log.
class EngineTest : public testing::Test
{
protected:
    void SetUp() override
    {
        FixedWait::setSleeper([](std::chrono::seconds duration) {
            const std::lock_guard<std::mutex> lock(recorderMutex);
            std::ofstream(std::getenv("FAKE_INSTRUMENT_DIR") + std::string("/journal"), std::ios::app)
                << "sleep " << duration.count() << '\n';
        });
        engine.setCallbacks([](UpdateManager::Result result) { record(result ? "UpdateFinished" : "NoUpdates"); },
                            [](UpdateManager::Error error) { record(kErrorNames[error]); },
                            [](std::vector<Component> list) {
                                std::string text = "UpdateFound:";
                                for (const Component &c : list)
                                    text += " " + std::to_string(c.type) + " " + c.name + " " + c.installedVersion
                                            + " -> " + c.candidateVersion + ";";
                                record(text);
                            });
        const std::lock_guard<std::mutex> lock(logCapture.mutex), recorderLock(recorderMutex);
        logCapture.text.clear();
        recorded.clear();
    }
    void TearDown() override
    {
        FixedWait::setSleeper(nullptr);
        if (HasFailure())
            std::fprintf(stderr, "Engine log:\n%s\n", engineLog().c_str());
    }

    static void record(const std::string &text)
    {
        {
            const std::lock_guard<std::mutex> lock(recorderMutex);
            recorded.emplace_back(text, std::this_thread::get_id());
        }
        // While a test holds the gate, a callback cannot return.
        const std::lock_guard<std::mutex> gate(callbackGate);
    }

    void script(int mirrorsStatus, Package package, Module module)
    {
        fake.answer("apt update", "Reading package lists... Done\n", mirrorsStatus);
        const bool due = package == Package::Due || package == Package::InstallFails;
        fake.answer("apt-cache policy *",
                    package == Package::QueryFails ? "" : due ? "  Installed: 1.4.2\n  Candidate: 1.5.0\n"
                                                              : "  Installed: 1.4.2\n  Candidate: 1.4.2\n");
        fake.answer("apt --assume-yes install *", "E: Unable to fetch\n", package == Package::InstallFails ? 100 : 0);
        // The module ends its version line the DOS way; once installed it reports 2.0.
        if (module == Module::Unreachable)
            fake.answer(kVersionRead, "", 255);
        if (module == Module::Due)
            fake.answer(kVersionRead, "Quillowmarsh\t1.9\r\n", 0, 1);
        const bool installed = module == Module::UpToDate || module == Module::Due;
        fake.answer(kVersionRead, installed ? "Quillowmarsh\t2.0\r\n" : "Quillowmarsh\t1.9\r\n");
        fake.answer(kListing, "2.0\n");
        fake.answer("scp *", "", module == Module::UploadFails ? 1 : 0);
        // The install script loses its connection when the module reboots.
        fake.answer(kInstallScript, "", 255);
    }

    // The engine never joins its workers: a test waits for what each phase does
    // last. A worker that never gets there ends the program, so that it cannot
    // outlive the fake instrument.
    template <typename Done>
    static void waitOrAbort(Done done)
    {
        for (int tick = 0; !done(); ++tick, std::this_thread::sleep_for(std::chrono::milliseconds(5))) {
            if (tick == 12'000) // a minute
                std::fprintf(stderr, "The engine never got there; its log:\n%s\n", engineLog().c_str()), std::abort();
        }
    }
    static Outcomes waitForOutcomes(std::size_t count)
    {
        Outcomes outcomes;
        waitOrAbort([&] {
            const std::lock_guard<std::mutex> lock(recorderMutex);
            return (outcomes = recorded).size() >= count;
        });
        return outcomes;
    }
    // The logged status of the updater's own stop is the wind-down's last act.
    static void waitForWindDown()
    {
        waitOrAbort([] { return std::regex_search(engineLog(), std::regex("stopUpdater\\(\\)\n\t\t\t-?[0-9]+\n")); });
    }

    bool ranInOrder(const std::vector<std::string> &globs) const
    {
        auto next = globs.begin();
        for (const std::string &call : fake.journal())
            next += next != globs.end() && fnmatch(next->c_str(), call.c_str(), 0) == 0;
        return next == globs.end();
    }
    int runs(const std::string &glob) const
    {
        const std::vector<std::string> calls = fake.journal();
        return std::count_if(calls.begin(), calls.end(),
                             [&](const std::string &call) { return fnmatch(glob.c_str(), call.c_str(), 0) == 0; });
    }

    FakeInstrument fake;
    UpdateManager &engine = *UpdateManager::instance();
};
