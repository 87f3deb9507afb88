#include "design/Tsy_OutputSet.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <sys/stat.h>
#include <vector>
#include <unistd.h>

namespace {

std::string reason()
{
    return std::strerror(errno);
}

bool writeAll(int fd, const std::string& content)
{
    size_t done = 0;
    while (done < content.size()) {
        ssize_t n = ::write(fd, content.data() + done, content.size() - done);
        if (n < 0) {
            if (errno == EINTR)
                continue;
            return false;
        }
        done += static_cast<size_t>(n);
    }
    return true;
}

// Writes the content to a fresh temporary next to the target; its name in tmp.
bool writeTemporary(const std::string& path, const std::string& content, std::string& tmp, std::string& error)
{
    std::vector<char> name(path.begin(), path.end());
    const char suffix[] = ".tmp-XXXXXX";
    name.insert(name.end(), suffix, suffix + sizeof(suffix));
    int fd = ::mkstemp(name.data());
    if (fd < 0) {
        error = path + ": cannot be written: " + reason();
        return false;
    }
    tmp = name.data();
    bool ok = writeAll(fd, content) && ::fsync(fd) == 0;
    std::string why = ok ? std::string() : reason();
    ok = (::close(fd) == 0) && ok;
    // mkstemp makes the file private; a design file is an ordinary file.
    ok = ok && ::chmod(tmp.c_str(), 0644) == 0;
    if (!ok) {
        error = path + ": cannot be written: " + (why.empty() ? reason() : why);
        ::unlink(tmp.c_str());
    }
    return ok;
}

} // namespace

void Tsy_OutputSet::Add(const std::string& path, std::string content)
{
    files_.emplace_back(path, std::move(content));
}

std::vector<std::string> Tsy_OutputSet::Paths() const
{
    std::vector<std::string> out;
    for (const auto& f : files_)
        out.push_back(f.first);
    return out;
}

bool Tsy_OutputSet::Commit(std::string& error)
{
    std::vector<std::string> temps;
    for (const auto& f : files_) {
        std::string tmp;
        if (!writeTemporary(f.first, f.second, tmp, error)) {
            for (const auto& t : temps)
                ::unlink(t.c_str());
            return false;
        }
        temps.push_back(tmp);
    }
    for (size_t i = 0; i < files_.size(); ++i) {
        if (::rename(temps[i].c_str(), files_[i].first.c_str()) != 0) {
            error = files_[i].first + ": cannot be replaced: " + reason();
            for (size_t j = i; j < temps.size(); ++j)
                ::unlink(temps[j].c_str());
            return false;
        }
    }
    return true;
}

bool Tsy_WriteFileAtomically(const std::string& path, const std::string& content, std::string& error)
{
    Tsy_OutputSet one;
    one.Add(path, content);
    return one.Commit(error);
}
