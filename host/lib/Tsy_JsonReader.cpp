#include "lib/Tsy_JsonReader.h"

#include "port/Exception.h"

#include <climits>

Tsy_JsonReader::Tsy_JsonReader(const nlohmann::ordered_json& node, std::string file, std::string path)
    : node_(node), file_(std::move(file)), path_(std::move(path))
{
    if (!node_.is_object())
        Fail("expected an object");
}

bool Tsy_JsonReader::Has(const std::string& key) const
{
    return node_.contains(key);
}

std::string Tsy_JsonReader::childPath(const std::string& key) const
{
    return path_.empty() ? key : path_ + "." + key;
}

void Tsy_JsonReader::Fail(const std::string& reason) const
{
    throw Port::Exception(file_ + ": " + (path_.empty() ? std::string("top level") : path_) + ": " + reason);
}

void Tsy_JsonReader::FailAt(const std::string& key, const std::string& reason) const
{
    throw Port::Exception(file_ + ": " + childPath(key) + ": " + reason);
}

const nlohmann::ordered_json& Tsy_JsonReader::member(const std::string& key) const
{
    auto it = node_.find(key);
    if (it == node_.end())
        FailAt(key, "missing");
    return *it;
}

std::string Tsy_JsonReader::RequiredString(const std::string& key) const
{
    const auto& v = member(key);
    if (!v.is_string())
        FailAt(key, "expected a string");
    return v.get<std::string>();
}

std::string Tsy_JsonReader::OptionalString(const std::string& key, const std::string& fallback) const
{
    return Has(key) ? RequiredString(key) : fallback;
}

int Tsy_JsonReader::OptionalInt(const std::string& key, int fallback) const
{
    if (!Has(key))
        return fallback;
    const auto& v = member(key);
    if (!v.is_number_integer())
        FailAt(key, "expected a whole number");
    long long n = v.get<long long>();
    if (n < INT_MIN || n > INT_MAX)
        FailAt(key, "number out of range");
    return static_cast<int>(n);
}

bool Tsy_JsonReader::OptionalBool(const std::string& key, bool fallback) const
{
    if (!Has(key))
        return fallback;
    const auto& v = member(key);
    if (!v.is_boolean())
        FailAt(key, "expected true or false");
    return v.get<bool>();
}

std::vector<std::string> Tsy_JsonReader::OptionalStringList(const std::string& key) const
{
    std::vector<std::string> out;
    if (!Has(key))
        return out;
    const auto& v = member(key);
    if (!v.is_array())
        FailAt(key, "expected a list of strings");
    for (const auto& e : v) {
        if (!e.is_string())
            FailAt(key, "expected a list of strings");
        out.push_back(e.get<std::string>());
    }
    return out;
}

std::vector<int> Tsy_JsonReader::IntList(const std::string& key) const
{
    std::vector<int> out;
    const auto& v = member(key);
    if (!v.is_array())
        FailAt(key, "expected a list of whole numbers");
    for (const auto& e : v) {
        if (!e.is_number_integer() || e.get<long long>() < INT_MIN || e.get<long long>() > INT_MAX)
            FailAt(key, "expected a list of whole numbers");
        out.push_back(static_cast<int>(e.get<long long>()));
    }
    return out;
}

void Tsy_JsonReader::ForEachMember(const std::string& key,
                                   const std::function<void(const std::string&, const Tsy_JsonReader&)>& visit) const
{
    if (!Has(key))
        return;
    const auto& v = member(key);
    if (!v.is_object())
        FailAt(key, "expected an object");
    for (auto it = v.begin(); it != v.end(); ++it) {
        if (!it.value().is_object())
            FailAt(key + "." + it.key(), "expected an object");
        visit(it.key(), Tsy_JsonReader(it.value(), file_, childPath(key) + "." + it.key()));
    }
}

void Tsy_JsonReader::ForEach(const std::string& key, const std::function<void(const Tsy_JsonReader&)>& visit) const
{
    if (!Has(key))
        return;
    const auto& v = member(key);
    if (!v.is_array())
        FailAt(key, "expected a list");
    for (size_t i = 0; i < v.size(); ++i) {
        std::string p = childPath(key) + "[" + std::to_string(i) + "]";
        if (!v[i].is_object())
            throw Port::Exception(file_ + ": " + p + ": expected an object");
        visit(Tsy_JsonReader(v[i], file_, p));
    }
}

Tsy_JsonReader Tsy_JsonReader::Child(const std::string& key) const
{
    const auto& v = member(key);
    if (!v.is_object())
        FailAt(key, "expected an object");
    return Tsy_JsonReader(v, file_, childPath(key));
}
