#pragma once

#include <sstream>
#include <string>

// The engine's log: one entry per step on standard output, a header line with
// time, thread, source position and function, then the message indented by
// three TABs.
namespace UpdaterLog {

std::string header(const char *file, int line, const char *function);

// Writes a complete entry and flushes it. Entries from different threads never
// interleave: each is written whole.
void write(const std::string &header, const std::string &message);

// Where an entry was written from; the message parts follow in write().
class Entry
{
public:
    Entry(const char *file, int line, const char *function)
        : mFile(file), mLine(line), mFunction(function)
    {
    }

    template <typename... Parts>
    void write(const Parts &...parts) const
    {
        std::ostringstream message;
        ((message << parts), ...);
        UpdaterLog::write(header(mFile, mLine, mFunction), message.str());
    }

private:
    const char *mFile;
    int mLine;
    const char *mFunction;
};

} // namespace UpdaterLog

#define UPDATER_LOG(...) UpdaterLog::Entry(__FILE__, __LINE__, __PRETTY_FUNCTION__).write(__VA_ARGS__)
