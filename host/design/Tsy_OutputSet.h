#pragma once
// A set of files written together: every file goes to a temporary beside its
// target first, and only when all of them are whole are they renamed into
// place. A failure leaves every earlier file as it was and no temporaries.

#include <string>
#include <utility>
#include <vector>

class Tsy_OutputSet {
public:
    void Add(const std::string& path, std::string content);
    // False with one line naming the file and the cause.
    bool Commit(std::string& error);
    std::vector<std::string> Paths() const;

private:
    std::vector<std::pair<std::string, std::string>> files_;
};

// One file written the same way.
bool Tsy_WriteFileAtomically(const std::string& path, const std::string& content, std::string& error);
