#include "wizard/Tsy_Family.h"

#include <initializer_list>

namespace Tsy_Family {

namespace {
bool oneOf(const StringBase& family, std::initializer_list<const char*> keys)
{
    for (const char* k : keys)
        if (family.Compare(k, Port::CompareNoCase) == 0)
            return true;
    return false;
}
} // namespace

bool IsGeneration45(const StringBase& f)
{
    return oneOf(f, {"taldor4", "qtaldor4", "qrtaldor4", "taldor5"});
}

bool IsGeneration4(const StringBase& f)
{
    return oneOf(f, {"taldor4", "qtaldor4", "qrtaldor4"});
}

bool IsMembra3E(const StringBase& f)
{
    return oneOf(f, {"membra3e", "membra3a", "membra3an", "amembra3e"});
}

bool IsTaldor2Pro(const StringBase& f)
{
    return oneOf(f, {"taldor2p", "qtaldor2p"});
}

bool IsTaldor2(const StringBase& f)
{
    return oneOf(f, {"taldor2", "qtaldor2", "qrtaldor2"});
}

bool IsMembra3(const StringBase& f)
{
    return oneOf(f, {"membra3", "amembra3"});
}

bool Is(const StringBase& f, const char* key)
{
    return f.Compare(key, Port::CompareNoCase) == 0;
}

} // namespace Tsy_Family
