#include "lib/Tsy_DataDir.h"

#include "port/Exception.h"

#include <cstdlib>
#include <fstream>
#include <sstream>
#include <sys/stat.h>
#include <unistd.h>

namespace {

// Line and column of a byte offset, for messages that point into the file.
std::string placeOf(const std::string& text, size_t offset)
{
    size_t line = 1, column = 1;
    for (size_t i = 0; i < offset && i < text.size(); ++i) {
        if (text[i] == '\n') {
            ++line;
            column = 1;
        } else {
            ++column;
        }
    }
    return "line " + std::to_string(line) + ", column " + std::to_string(column);
}

} // namespace

bool Tsy_IsDirectory(const std::string& path)
{
    struct stat st {};
    return stat(path.c_str(), &st) == 0 && S_ISDIR(st.st_mode);
}

std::string Tsy_ExecutableDir()
{
    char buf[4096];
    ssize_t n = readlink("/proc/self/exe", buf, sizeof(buf) - 1);
    if (n <= 0)
        return std::string();
    std::string path(buf, static_cast<size_t>(n));
    return path.substr(0, path.find_last_of('/'));
}

std::string Tsy_DataDir()
{
    if (const char* env = std::getenv("PENDRA_DATA_DIR"); env && *env)
        return env;
    std::string installed = Tsy_ExecutableDir() + "/../share/pendra";
    if (Tsy_IsDirectory(installed))
        return installed;
    return PENDRA_SOURCE_DATA_DIR;
}

std::string Tsy_DataFile(const std::string& relative)
{
    return Tsy_DataDir() + "/" + relative;
}

nlohmann::ordered_json Tsy_ParseJson(const std::string& text, const std::string& origin)
{
    try {
        return nlohmann::ordered_json::parse(text);
    } catch (const nlohmann::ordered_json::parse_error& e) {
        std::string reason = e.what();
        // nlohmann prefixes its own position text; keep only the reason.
        size_t colon = reason.rfind(": ");
        if (colon != std::string::npos)
            reason = reason.substr(colon + 2);
        throw Port::Exception(origin + ": " + placeOf(text, e.byte > 0 ? e.byte - 1 : 0) + ": " + reason);
    }
}

nlohmann::ordered_json Tsy_ReadJsonFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    if (!in || Tsy_IsDirectory(path))
        throw Port::Exception(path + ": cannot be read");
    std::ostringstream text;
    text << in.rdbuf();
    if (in.bad())
        throw Port::Exception(path + ": cannot be read");
    return Tsy_ParseJson(text.str(), path);
}
