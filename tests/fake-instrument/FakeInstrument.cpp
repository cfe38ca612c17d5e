#include "FakeInstrument.h"

#include "FakeInstrumentPaths.h"

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <system_error>

namespace {

std::optional<std::string> environmentValue(const char *name)
{
    const char *value = std::getenv(name);
    return value ? std::optional<std::string>(value) : std::nullopt;
}

void restoreEnvironment(const char *name, const std::optional<std::string> &value)
{
    if (value)
        setenv(name, value->c_str(), 1);
    else
        unsetenv(name);
}

void writeFile(const std::string &path, const std::string &bytes)
{
    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    if (!file.flush())
        throw std::runtime_error("fake instrument: cannot write " + path);
}

std::string makeScenarioDir()
{
    const std::string base = environmentValue("TMPDIR").value_or("/tmp");
    std::string pattern = base + "/fake-instrument.XXXXXX";
    if (!mkdtemp(pattern.data()))
        throw std::system_error(errno, std::generic_category(), "fake instrument: mkdtemp");
    return pattern;
}

} // namespace

FakeInstrument::FakeInstrument()
    : mScenarioDir(makeScenarioDir()),
      mPreviousPath(environmentValue("PATH")),
      mPreviousScenario(environmentValue("FAKE_INSTRUMENT_DIR"))
{
    std::filesystem::create_directory(mScenarioDir + "/rules");
    const std::string path = binDir() + (mPreviousPath ? ":" + *mPreviousPath : std::string());
    setenv("PATH", path.c_str(), 1);
    setenv("FAKE_INSTRUMENT_DIR", mScenarioDir.c_str(), 1);
}

FakeInstrument::~FakeInstrument()
{
    restoreEnvironment("PATH", mPreviousPath);
    restoreEnvironment("FAKE_INSTRUMENT_DIR", mPreviousScenario);
    std::error_code ignored;
    std::filesystem::remove_all(mScenarioDir, ignored);
}

void FakeInstrument::answer(const std::string &glob, const std::string &stdoutBytes, int exitStatus,
                            int uses)
{
    writeFile(addRule(glob, exitStatus, uses) + "/stdout", stdoutBytes);
}

void FakeInstrument::endBySignal(const std::string &glob, int signal)
{
    writeFile(addRule(glob, 128 + signal, unlimited) + "/signal", std::to_string(signal));
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

const std::string &FakeInstrument::scenarioDir() const
{
    return mScenarioDir;
}

std::string FakeInstrument::binDir()
{
    return FAKE_INSTRUMENT_BIN_DIR;
}

std::string FakeInstrument::addRule(const std::string &glob, int exitStatus, int uses)
{
    // Zero-padded names keep the rules in the order they were added.
    char name[16];
    std::snprintf(name, sizeof name, "%04d", ++mRuleCount);
    const std::string rule = mScenarioDir + "/rules/" + name;
    std::filesystem::create_directory(rule);
    writeFile(rule + "/glob", glob);
    writeFile(rule + "/status", std::to_string(exitStatus));
    if (uses != unlimited)
        writeFile(rule + "/uses", std::to_string(uses));
    return rule;
}
