#pragma once
// Layout both HDL writers share: comment banners, aligned columns, the ends
// of list items, and which library attributes a primitive declares as its
// parameters. What each language spells its own way stays in its writer.

#include <algorithm>
#include <string>
#include <vector>

struct Tsy_AttrDef;
struct Tsy_PrimitiveDef;

// The banner as comment lines opened by marker ("//", "--"); an empty line
// is the bare marker.
std::string Tsy_HdlCommentBanner(const std::vector<std::string>& banner, const std::string& marker);

// The text followed by spaces up to the width.
std::string Tsy_HdlPadded(const std::string& text, size_t width);

// What follows item i of a list of count items: the separator and a line
// break, or only the line break after the last.
std::string Tsy_HdlItemEnd(size_t i, size_t count, const char* separator);

// The width of a column that shows column(item) for every item.
template <class Items, class Column>
size_t Tsy_HdlColumnWidth(const Items& items, Column column)
{
    size_t width = 0;
    for (const auto& item : items)
        width = std::max(width, column(item).size());
    return width;
}

// The attributes of the primitive that the HDL sees as its parameters, in
// the primitive's order; the wizard's own settings are not among them.
std::vector<const Tsy_AttrDef*> Tsy_HdlParameterDefs(const Tsy_PrimitiveDef& def);

// The library default of a parameter in canonical form, or the neutral value
// of its type where the default does not suit it.
std::string Tsy_HdlDefaultValue(const Tsy_AttrDef& ad);
