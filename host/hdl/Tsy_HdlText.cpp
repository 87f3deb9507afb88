#include "hdl/Tsy_HdlText.h"

#include "hdl/Tsy_HdlValues.h"
#include "lib/Tsy_PrimitiveLibrary.h"

std::string Tsy_HdlCommentBanner(const std::vector<std::string>& banner, const std::string& marker)
{
    std::string out;
    for (const auto& line : banner)
        out += line.empty() ? marker + "\n" : marker + " " + line + "\n";
    return out;
}

std::string Tsy_HdlPadded(const std::string& text, size_t width)
{
    return text + std::string(width > text.size() ? width - text.size() : 0, ' ');
}

std::string Tsy_HdlItemEnd(size_t i, size_t count, const char* separator)
{
    return i + 1 < count ? std::string(separator) + "\n" : std::string("\n");
}

std::vector<const Tsy_AttrDef*> Tsy_HdlParameterDefs(const Tsy_PrimitiveDef& def)
{
    std::vector<const Tsy_AttrDef*> out;
    for (const auto& ad : def.attributes)
        if (ad.IsHdlProperty())
            out.push_back(&ad);
    return out;
}

std::string Tsy_HdlDefaultValue(const Tsy_AttrDef& ad)
{
    std::string value, expected;
    if (!Tsy_HdlCanonicalValue(ad.hdlType, ad.defaultValue, value, expected))
        value = Tsy_HdlNeutralValue(ad.hdlType);
    return value;
}
