#pragma once
// Reading a JSON document with messages that point into it: every fault is
// thrown as Port::Exception "<file>: <path in the document>: <reason>".

#include <nlohmann/json.hpp>

#include <functional>
#include <string>
#include <vector>

class Tsy_JsonReader {
public:
    Tsy_JsonReader(const nlohmann::ordered_json& node, std::string file, std::string path = std::string());

    const nlohmann::ordered_json& Node() const { return node_; }
    const std::string& Path() const { return path_; }
    bool Has(const std::string& key) const;

    std::string RequiredString(const std::string& key) const;
    std::string OptionalString(const std::string& key, const std::string& fallback) const;
    int OptionalInt(const std::string& key, int fallback) const;
    bool OptionalBool(const std::string& key, bool fallback) const;
    std::vector<std::string> OptionalStringList(const std::string& key) const;
    std::vector<int> IntList(const std::string& key) const;
    // Object members in document order, each value a reader of its own.
    void ForEachMember(const std::string& key,
                       const std::function<void(const std::string&, const Tsy_JsonReader&)>& visit) const;
    // Elements of an array member (absent means none).
    void ForEach(const std::string& key, const std::function<void(const Tsy_JsonReader&)>& visit) const;
    Tsy_JsonReader Child(const std::string& key) const;

    [[noreturn]] void Fail(const std::string& reason) const;
    [[noreturn]] void FailAt(const std::string& key, const std::string& reason) const;

private:
    const nlohmann::ordered_json& member(const std::string& key) const;
    std::string childPath(const std::string& key) const;

    const nlohmann::ordered_json& node_;
    std::string file_;
    std::string path_;
};
