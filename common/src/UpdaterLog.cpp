#include "UpdaterLog.h"

#include <cstring>
#include <ctime>
#include <iomanip>
#include <iostream>
#include <mutex>
#include <thread>

namespace UpdaterLog {

namespace {

const char *baseName(const char *path)
{
    const char *slash = std::strrchr(path, '/');
    return slash ? slash + 1 : path;
}

} // namespace

std::string header(const char *file, int line, const char *function)
{
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);

    std::ostringstream out;
    out << "Updater | " << std::put_time(&local, "%d-%m-%Y %H-%M-%S") << '\t'
        << std::this_thread::get_id() << '\t' << baseName(file) << ':' << line << '\t' << function;
    return out.str();
}

void write(const std::string &header, const std::string &message)
{
    // The GUI thread and a worker may log at the same moment; a field
    // engineer reading the log must still see every entry in one piece.
    static std::mutex streamMutex;
    const std::lock_guard<std::mutex> lock(streamMutex);
    std::cout << header << "\n\t\t\t" << message << std::endl;
}

} // namespace UpdaterLog
