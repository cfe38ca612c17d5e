#pragma once

#include <sstream>
#include <string>
#include <vector>

// Helpers for reading what apt, ls and the module print.
namespace TextLines {

// Lines split at each newline; a last line without newline counts, a final
// newline opens no empty line. Carriage returns stay where they are.
inline std::vector<std::string> split(const std::string &text)
{
    std::vector<std::string> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);)
        lines.push_back(line);
    return lines;
}

// Erases `line` from its start through the first occurrence of `key`.
// Returns false, leaving `line` alone, when `key` does not occur.
inline bool eraseThrough(std::string &line, const std::string &key)
{
    const std::string::size_type position = line.find(key);
    if (position == std::string::npos)
        return false;
    line.erase(0, position + key.size());
    return true;
}

// The text up to its first newline: the first name a listing prints.
inline std::string firstLine(const std::string &text)
{
    return text.substr(0, text.find('\n'));
}

} // namespace TextLines
