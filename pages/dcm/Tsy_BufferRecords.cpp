#include "pages/dcm/Tsy_BufferRecords.h"

#include "db/Tsy_WizData.h"
#include "wizard/Tsy_Vocabulary.h"

#include <string>
#include <vector>

namespace Tsy_BufferRecords {

namespace {

struct TypeInfo {
    const char* type;
    const char* shown;
    const char* picture;
};

const TypeInfo kTypes[] = {
    {"BUFG", "Global Buffer", "bufg"},
    {"BUFGCE", "Enabled Buffer", "bufgce"},
    {"BUFGMUX", "Clock Mux", "bufgmux"},
    {"BUFGCTRL", "Clock Mux Control", "bufgctrl"},
    {"BUFGMUX_TALDOR4", "Clock Mux for Taldor4", "bufgmuxtal4"},
    {"BUFGMUX_CTRL", "Global Clock Mux", "bufgmux_ctrl"},
    {"OBUF", "Output Buffer", ""},
    {"LOCALROUTING", "Local Routing", "localrout"},
    {"LOWSKEWLINE", "Lowskewline", "lowskew"},
};

const TypeInfo* find(const StringBase& type)
{
    for (const auto& t : kTypes)
        if (type.EqualsNoCase(t.type))
            return &t;
    return nullptr;
}

StringBase typeName(int n)
{
    return StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N, n);
}

StringBase stateName(int n)
{
    return StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N_NOEDIT, n);
}

// Digits right after position start: the number, or 0 when there is none, it
// starts with a zero, or it is too long to be a buffer number.
int numberAt(const std::string& s, size_t start, size_t& end)
{
    end = start;
    while (end < s.size() && s[end] >= '0' && s[end] <= '9')
        ++end;
    if (end == start || s[start] == '0' || end - start > 4)
        return 0;
    return std::stoi(s.substr(start, end - start));
}

} // namespace

StringBase ShownName(const StringBase& type)
{
    const TypeInfo* t = find(type);
    return t ? StringBase(t->shown) : type;
}

StringBase PictureName(const StringBase& type)
{
    const TypeInfo* t = find(type);
    return t ? StringBase(t->picture) : StringBase();
}

bool IsMuxType(const StringBase& type)
{
    return type.EqualsNoCase("BUFGMUX") || type.EqualsNoCase("BUFGMUX_TALDOR4") || type.EqualsNoCase("BUFGMUX_CTRL") ||
           type.EqualsNoCase("BUFGCTRL");
}

bool IsGlobalType(const StringBase& type)
{
    return type.EqualsNoCase("BUFG") || type.EqualsNoCase("BUFGCE") || IsMuxType(type);
}

StringBase TypeOf(const Tsy_Pin* pin, int n)
{
    return pin ? pin->GetAttributeValue(typeName(n)) : StringBase();
}

int ReadRowState(int n, const Tsy_Pin* pin)
{
    if (!pin)
        return StateEnabled;
    StringBase v = pin->GetAttributeValue(stateName(n));
    if (v.IsEmpty() || v.EqualsNoCase(Tsy_BufState::ENABLED))
        return StateEnabled;
    if (v.EqualsNoCase(Tsy_BufState::FEEDBACK))
        return StateFeedback;
    if (v.EqualsNoCase(Tsy_BufState::DEFAULT))
        return StateDefault;
    // DISABLED_BUF, and whatever else another page fixed the buffer with.
    return StateDisabled;
}

void WriteRowState(Tsy_Pin* pin, int n, int state)
{
    if (!pin)
        return;
    switch (state) {
    case StateEnabled:
        pin->RemoveAttribute(stateName(n));
        break;
    case StateFeedback:
        pin->AddAttribute(stateName(n), Tsy_BufState::FEEDBACK);
        break;
    case StateDefault:
        pin->AddAttribute(stateName(n), Tsy_BufState::DEFAULT);
        break;
    default:
        pin->AddAttribute(stateName(n), Tsy_BufState::DISABLED);
        break;
    }
}

void WriteBufferType(Tsy_Pin* pin, int n, const StringBase& type, int state)
{
    if (!pin)
        return;
    pin->AddAttribute(typeName(n), type);
    WriteRowState(pin, n, state);
}

int NextFreeBuffer(const Tsy_Pin* pin)
{
    int n = 1;
    // A pin holds at most a few hundred attributes, so this ends.
    while (pin && !TypeOf(pin, n).IsEmpty())
        ++n;
    return n;
}

bool HasAnyBufferRecord(const Tsy_Pin* pin)
{
    if (!pin)
        return false;
    for (const auto& a : pin->Attributes())
        if (a->GetName().StartsWith(Tsy_Attr::TSY_CLKBUFTYPE))
            return true;
    return false;
}

bool HasOtherBuffer(const Tsy_Pin* pin, int n)
{
    if (!pin)
        return false;
    for (const auto& a : pin->Attributes()) {
        StringBase tail;
        int k = BufferNumberOf(a->GetName(), nullptr, &tail);
        if (k > 0 && k != n && tail.IsEmpty() && a->GetName().StartsWith(Tsy_Attr::TSY_CLKBUFTYPE) &&
            !a->GetValue().IsEmpty())
            return true;
    }
    return false;
}

int BufferNumberOf(const StringBase& attrName, StringBase* head, StringBase* tail)
{
    const std::string& s = attrName.str();
    const std::string typePrefix = Tsy_Attr::TSY_CLKBUFTYPE; // "TSY_CLKBUFTYPE"
    const std::string bufPrefix = "TSY_CLKBUF";
    size_t start = 0;
    bool typeRecord = false;
    if (s.compare(0, typePrefix.size(), typePrefix) == 0) {
        start = typePrefix.size();
        typeRecord = true;
    } else if (s.compare(0, bufPrefix.size(), bufPrefix) == 0) {
        start = bufPrefix.size();
    } else {
        return 0;
    }
    size_t end = 0;
    int n = numberAt(s, start, end);
    if (n == 0)
        return 0;
    // "TSY_CLKBUFTYPE3" and "TSY_CLKBUFTYPE3_NOEDIT"; "TSY_CLKBUF3_..." always
    // has a port or kind after the number.
    bool rest = end < s.size();
    if (rest && s[end] != '_')
        return 0;
    if (!typeRecord && !rest)
        return 0;
    if (head)
        *head = s.substr(0, start);
    if (tail)
        *tail = s.substr(end);
    return n;
}

namespace {

struct Saved {
    StringBase head;
    int n;
    StringBase tail;
    StringBase value;
    bool active;
};

// Takes every record of buffers numbered from n up off the pin.
std::vector<Saved> takeFrom(Tsy_Pin* pin, int n)
{
    std::vector<Saved> taken;
    std::vector<StringBase> names;
    for (const auto& a : pin->Attributes()) {
        Saved s;
        s.n = BufferNumberOf(a->GetName(), &s.head, &s.tail);
        if (s.n < n)
            continue;
        s.value = a->GetValue();
        s.active = a->IsActive();
        taken.push_back(s);
        names.push_back(a->GetName());
    }
    for (const auto& name : names)
        pin->RemoveAttribute(name);
    return taken;
}

} // namespace

void ClearBuffer(Tsy_Pin* pin, int n)
{
    if (!pin || n < 1)
        return;
    for (const Saved& s : takeFrom(pin, n)) {
        if (s.n == n)
            continue;
        StringBase name = s.head + StringBase::Printf("%d", s.n) + s.tail;
        pin->SetAttributeValue(name, s.value);
        pin->SetAttributeIsActive(name, s.active);
    }
}

void RemoveBuffer(Tsy_Pin* pin, int n)
{
    if (!pin || n < 1)
        return;
    for (const Saved& s : takeFrom(pin, n)) {
        if (s.n == n)
            continue;
        StringBase name = s.head + StringBase::Printf("%d", s.n - 1) + s.tail;
        pin->SetAttributeValue(name, s.value);
        pin->SetAttributeIsActive(name, s.active);
    }
}

} // namespace Tsy_BufferRecords
