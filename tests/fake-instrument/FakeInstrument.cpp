#include "FakeInstrument.h"

#include "FakeInstrumentPaths.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>

namespace {

std::optional<std::string> environmentValue(const char *name)
{
    const char *value = std::getenv(name);
    return value ? std::optional<std::string>(value) : std::nullopt;
}

void writeFile(const std::string &path, const std::string &bytes)
{
    if (!(std::ofstream(path, std::ios::binary) << bytes << std::flush))
        throw std::runtime_error("fake instrument: cannot write " + path);
}

} // namespace

FakeInstrument::FakeInstrument()
    : mScenarioDir(environmentValue("TMPDIR").value_or("/tmp") + "/fake-instrument.XXXXXX"),
      mPreviousPath(environmentValue("PATH")), mPreviousScenario(environmentValue("FAKE_INSTRUMENT_DIR"))
{
    if (!mkdtemp(mScenarioDir.data()))
        throw std::runtime_error("fake instrument: cannot make " + mScenarioDir);
    std::filesystem::create_directory(mScenarioDir + "/rules");
    setenv("PATH", (binDir() + (mPreviousPath ? ":" + *mPreviousPath : "")).c_str(), 1);
    setenv("FAKE_INSTRUMENT_DIR", mScenarioDir.c_str(), 1);
}

FakeInstrument::~FakeInstrument()
{
    mPreviousPath ? setenv("PATH", mPreviousPath->c_str(), 1) : unsetenv("PATH");
    mPreviousScenario ? setenv("FAKE_INSTRUMENT_DIR", mPreviousScenario->c_str(), 1) : unsetenv("FAKE_INSTRUMENT_DIR");
    std::error_code ignored;
    std::filesystem::remove_all(mScenarioDir, ignored);
}

void FakeInstrument::answer(const std::string &glob, const std::string &stdoutBytes, int exitStatus, int uses)
{
    ++mRuleCount;
    std::filesystem::create_directory(lastRule());
    writeFile(lastRule() + "/glob", glob);
    writeFile(lastRule() + "/status", std::to_string(exitStatus));
    writeFile(lastRule() + "/stdout", stdoutBytes);
    if (uses != unlimited)
        writeFile(lastRule() + "/uses", std::to_string(uses));
}

void FakeInstrument::endBySignal(const std::string &glob, int signal)
{
    answer(glob, "", 128 + signal);
    writeFile(lastRule() + "/signal", std::to_string(signal));
}

void FakeInstrument::recordEnvironment()
{
    writeFile(mScenarioDir + "/record-env", "");
}

std::vector<std::string> FakeInstrument::journal() const
{
    std::vector<std::string> calls;
    std::ifstream file(mScenarioDir + "/journal");
    for (std::string line; std::getline(file, line);)
        calls.push_back(line);
    return calls;
}

std::string FakeInstrument::binDir()
{
    return FAKE_INSTRUMENT_BIN_DIR;
}
