#include "db/Tsy_WizData.h"

#include "lib/Tsy_PrimitiveLibrary.h"
#include "port/UtStr.h"

#include <algorithm>
#include <cstdlib>

// ---------------------------------------------------------------- string array

int Tsy_StrArray::Add(const StringBase& s)
{
    items_.push_back(s);
    return static_cast<int>(items_.size()) - 1;
}

StringBase Tsy_StrArray::GetAt(int i) const
{
    if (i < 0 || i >= GetSize())
        return StringBase();
    return items_[static_cast<size_t>(i)];
}

bool Tsy_StrArray::Contains(const StringBase& s) const
{
    return std::find(items_.begin(), items_.end(), s) != items_.end();
}

// ---------------------------------------------------------------- attributes

Tsy_Attribute::Tsy_Attribute(StringBase name, StringBase value, const Tsy_AttrDef* def)
    : name_(std::move(name)), value_(std::move(value)), def_(def)
{
}

Tsy_StrArray Tsy_Attribute::GetValueList() const
{
    Tsy_StrArray list;
    if (def_)
        for (const auto& v : def_->values)
            list.Add(v);
    return list;
}

bool Tsy_Attribute::GetRangeValues(const StringBase& key, int& low, int& high) const
{
    int colon = key.GetIndexOfString(":");
    if (colon <= 0)
        return false;
    int lo = 0, hi = 0;
    if (!UT_STR::ParseInt(key.Left(static_cast<size_t>(colon)), lo)
        || !UT_STR::ParseInt(key.Mid(static_cast<size_t>(colon) + 1), hi) || lo > hi)
        return false;
    low = lo;
    high = hi;
    return true;
}

StringBase Tsy_Attribute::GetHdlType() const
{
    return def_ ? StringBase(def_->hdlType) : StringBase("string");
}

Tsy_AttrHolder::Tsy_AttrHolder(const Tsy_AttrHolder& other)
{
    *this = other;
}

Tsy_AttrHolder& Tsy_AttrHolder::operator=(const Tsy_AttrHolder& other)
{
    if (this == &other)
        return *this;
    attrs_.clear();
    for (const auto& a : other.attrs_)
        attrs_.push_back(std::make_unique<Tsy_Attribute>(*a));
    return *this;
}

Tsy_Attribute* Tsy_AttrHolder::GetNamedAttribute(const StringBase& name) const
{
    for (const auto& a : attrs_)
        if (a->GetName() == name)
            return a.get();
    return nullptr;
}

StringBase Tsy_AttrHolder::GetAttributeValue(const StringBase& name) const
{
    const Tsy_Attribute* a = GetNamedAttribute(name);
    return a ? a->GetValue() : StringBase();
}

bool Tsy_AttrHolder::SetAttributeValue(const StringBase& name, const StringBase& value)
{
    if (Tsy_Attribute* a = GetNamedAttribute(name)) {
        a->SetValue(value);
        return true;
    }
    attrs_.push_back(std::make_unique<Tsy_Attribute>(name, value, DefinitionOf(name)));
    return true;
}

Tsy_Attribute* Tsy_AttrHolder::AddAttribute(const StringBase& name, const StringBase& value)
{
    SetAttributeValue(name, value);
    Tsy_Attribute* a = GetNamedAttribute(name);
    a->SetIsActive(true);
    return a;
}

bool Tsy_AttrHolder::RemoveAttribute(const StringBase& name)
{
    auto it = std::find_if(attrs_.begin(), attrs_.end(), [&](const auto& a) { return a->GetName() == name; });
    if (it == attrs_.end())
        return false;
    attrs_.erase(it);
    return true;
}

bool Tsy_AttrHolder::SetAttributeIsActive(const StringBase& name, bool active)
{
    Tsy_Attribute* a = GetNamedAttribute(name);
    if (!a)
        return false;
    a->SetIsActive(active);
    return true;
}

int Tsy_AttrHolder::RemoveAllPropsWBase(const StringBase& prefix)
{
    size_t before = attrs_.size();
    attrs_.erase(std::remove_if(attrs_.begin(), attrs_.end(),
                                [&](const auto& a) { return a->GetName().StartsWith(prefix); }),
                 attrs_.end());
    return static_cast<int>(before - attrs_.size());
}

// ---------------------------------------------------------------- pins

Tsy_Pin::Tsy_Pin(Tsy_Block* block, StringBase name, StringBase direction, int width)
    : block_(block), name_(std::move(name)), direction_(std::move(direction))
{
    SetWidth(width);
}

void Tsy_Pin::SetSigName(const StringBase& signalName)
{
    sigName_ = signalName;
    if (!sigName_.IsEmpty()) {
        grounded_ = false;
        vcc_ = false;
    }
}

void Tsy_Pin::SetIsGrounded(bool on)
{
    grounded_ = on;
    if (on) {
        vcc_ = false;
        sigName_ = StringBase();
    }
}

void Tsy_Pin::SetIsVcc(bool on)
{
    vcc_ = on;
    if (on) {
        grounded_ = false;
        sigName_ = StringBase();
    }
}

void Tsy_Pin::ClearAllConnections()
{
    sigName_ = StringBase();
    grounded_ = false;
    vcc_ = false;
}

// ---------------------------------------------------------------- blocks

Tsy_Block::Tsy_Block(StringBase name, StringBase type, const Tsy_PrimitiveDef* def)
    : name_(std::move(name)), type_(std::move(type)), def_(def)
{
}

Tsy_Block::Tsy_Block(const Tsy_Block& other, const StringBase& newName)
    : Tsy_AttrHolder(other), active(other.active), name_(newName), type_(other.type_), def_(other.def_),
      generated_(other.generated_)
{
    for (const auto& p : other.pins_) {
        auto copy = std::make_unique<Tsy_Pin>(*p);
        copy->block_ = this;
        pins_.push_back(std::move(copy));
    }
}

const Tsy_AttrDef* Tsy_Block::DefinitionOf(const StringBase& name) const
{
    return def_ ? def_->FindAttr(name.str()) : nullptr;
}

Tsy_Pin* Tsy_Block::AddPin(const StringBase& pinName, const StringBase& direction)
{
    if (Tsy_Pin* existing = GetNamedPin(pinName))
        return existing;
    const Tsy_PinDef* pd = def_ ? def_->FindPin(pinName.str()) : nullptr;
    pins_.push_back(std::make_unique<Tsy_Pin>(this, pinName, direction, pd ? pd->width : 1));
    return pins_.back().get();
}

Tsy_Pin* Tsy_Block::GetNamedPin(const StringBase& name) const
{
    for (const auto& p : pins_)
        if (p->GetName() == name)
            return p.get();
    return nullptr;
}

bool Tsy_Block::DeletePin(Tsy_Pin* pin)
{
    auto it = std::find_if(pins_.begin(), pins_.end(), [&](const auto& p) { return p.get() == pin; });
    if (it == pins_.end())
        return false;
    pins_.erase(it);
    return true;
}

void Tsy_Block::ClearAllPinSignals()
{
    for (auto& p : pins_)
        p->ClearAllConnections();
}

void Tsy_Block::SetAllPinsIsActive(bool on)
{
    for (auto& p : pins_)
        p->SetIsActive(on);
}

void Tsy_Block::Retype(const StringBase& type, const Tsy_PrimitiveDef* def)
{
    type_ = type;
    def_ = def;
    std::vector<StringBase> dropped;
    for (const auto& a : Attributes()) {
        const Tsy_AttrDef* ad = DefinitionOf(a->GetName());
        a->SetDef(ad);
        if (!ad && !Tsy_IsWizardAttributeName(a->GetName().str()))
            dropped.push_back(a->GetName());
    }
    for (const auto& name : dropped)
        RemoveAttribute(name);
    pins_.erase(std::remove_if(pins_.begin(), pins_.end(),
                               [&](const auto& p) { return !def || !def->FindPin(p->GetName().str()); }),
                pins_.end());
    FillFromDefinition();
}

void Tsy_Block::FillFromDefinition()
{
    if (!def_)
        return;
    for (const auto& pd : def_->pins) {
        if (GetNamedPin(pd.name))
            continue;
        Tsy_Pin* pin = AddPin(pd.name, pd.direction);
        pin->SetIsActive(pd.startsActive);
    }
    for (const auto& ad : def_->attributes) {
        if (!ad.onTemplate || GetNamedAttribute(ad.name))
            continue;
        SetAttributeValue(ad.name, ad.defaultValue);
        SetAttributeIsActive(ad.name, ad.startsActive);
    }
}

// ---------------------------------------------------------------- signals

Tsy_Signal::Tsy_Signal(StringBase name, bool external, StringBase direction)
    : name_(std::move(name)), external_(external), direction_(std::move(direction))
{
}

void Tsy_Signal::SetExternal(bool external, const StringBase& direction)
{
    external_ = external;
    direction_ = external ? direction : StringBase();
}

void Tsy_Signal::SetIsBus(bool bus, int width)
{
    bus_ = bus && width > 1;
    width_ = bus_ ? width : 1;
}

// ---------------------------------------------------------------- database

Tsy_WizData::Tsy_WizData(const Tsy_PrimitiveLibrary& library) : lib_(library) {}

Tsy_WizData::~Tsy_WizData() = default;

static int instNumOf(const Tsy_Block& b)
{
    StringBase v = b.GetAttributeValue("TESY_ONLY_INST_NUM");
    int n = 0;
    return UT_STR::ParseInt(v, n) ? n : 0;
}

Tsy_Block* Tsy_WizData::insertBlock(std::unique_ptr<Tsy_Block> block)
{
    blocks_.push_back(std::move(block));
    return blocks_.back().get();
}

Tsy_Block* Tsy_WizData::AddTemplateBlock(const StringBase& primType)
{
    const Tsy_PrimitiveDef* def = lib_.Find(primType.str());
    if (!def || GetPrimitiveBlock(primType))
        return nullptr;
    auto block = std::make_unique<Tsy_Block>(primType + "_INST", primType, def);
    block->SetIsTemplate(true);
    block->FillFromDefinition();
    return insertBlock(std::move(block));
}

Tsy_Block* Tsy_WizData::GetNamedBlock(const StringBase& name) const
{
    // An active block wins over an inactive one left over from earlier runs.
    Tsy_Block* inactive = nullptr;
    for (const auto& b : blocks_) {
        if (b->GetName() != name)
            continue;
        if (b->active)
            return b.get();
        if (!inactive)
            inactive = b.get();
    }
    return inactive;
}

Tsy_Signal* Tsy_WizData::GetNamedSignal(const StringBase& name) const
{
    for (const auto& s : signals_)
        if (s->GetName() == name)
            return s.get();
    return nullptr;
}

Tsy_Block* Tsy_WizData::GetActiveBlock(const StringBase& primType) const
{
    for (const auto& b : blocks_)
        if (b->active && b->GetType() == primType)
            return b.get();
    return nullptr;
}

Tsy_Block* Tsy_WizData::GetActiveBlockInstNum(const StringBase& primType, int instNum) const
{
    for (const auto& b : blocks_)
        if (b->active && b->GetType() == primType && instNumOf(*b) == instNum)
            return b.get();
    return nullptr;
}

Tsy_Block* Tsy_WizData::GetBlockInstNum(const StringBase& primType, int instNum) const
{
    for (const auto& b : blocks_)
        if (b->GetType() == primType && instNumOf(*b) == instNum)
            return b.get();
    return nullptr;
}

Tsy_Block* Tsy_WizData::GetPrimitiveBlock(const StringBase& primType) const
{
    for (const auto& b : blocks_)
        if (b->IsTemplate() && b->GetType() == primType)
            return b.get();
    return nullptr;
}

Tsy_Block* Tsy_WizData::ConvertActiveBlk(const StringBase& fromType, const StringBase& toType, int instNum)
{
    Tsy_Block* from = instNum == 0 ? GetActiveBlock(fromType) : GetActiveBlockInstNum(fromType, instNum);
    const Tsy_PrimitiveDef* def = lib_.Find(toType.str());
    if (!from || !def)
        return nullptr;
    from->Retype(toType, def);
    // A converted block is the design's block of the new type now; it no
    // longer stands for the old primitive's template.
    from->SetIsTemplate(false);
    return from;
}

Tsy_Block* Tsy_WizData::CopyBlock(const Tsy_Block* block, const StringBase& newName)
{
    if (!block || newName.IsEmpty())
        return nullptr;
    if (Tsy_Block* holder = GetNamedBlock(newName)) {
        if (holder->active || holder->IsTemplate())
            return nullptr;
        RemoveBlock(holder);
    }
    auto copy = std::make_unique<Tsy_Block>(*block, newName);
    copy->active = false;
    copy->SetIsTemplate(false);
    return insertBlock(std::move(copy));
}

Tsy_Block* Tsy_WizData::AddBlock(const StringBase& instanceName, const StringBase& primType)
{
    if (instanceName.IsEmpty())
        return nullptr;
    while (Tsy_Block* holder = GetNamedBlock(instanceName)) {
        if (holder->active || holder->IsTemplate())
            return nullptr;
        RemoveBlock(holder);
    }
    auto block = std::make_unique<Tsy_Block>(instanceName, primType, lib_.Find(primType.str()));
    block->active = true;
    block->SetIsGenerated(true);
    return insertBlock(std::move(block));
}

bool Tsy_WizData::RemoveBlock(Tsy_Block* block)
{
    auto it = std::find_if(blocks_.begin(), blocks_.end(), [&](const auto& b) { return b.get() == block; });
    if (it == blocks_.end())
        return false;
    blocks_.erase(it);
    return true;
}

Tsy_Signal* Tsy_WizData::AddSignal(const StringBase& name, bool isExternal, const StringBase& direction)
{
    Tsy_Signal* s = GetNamedSignal(name);
    if (!s) {
        signals_.push_back(std::make_unique<Tsy_Signal>(name, isExternal, isExternal ? direction : StringBase()));
        s = signals_.back().get();
    } else if (!s->IsActive()) {
        s->SetExternal(isExternal, direction);
        s->SetIsBus(false, 1);
    } else if (isExternal) {
        // An internal net that becomes a port keeps its name and its drivers.
        s->SetExternal(true, direction);
    }
    s->SetIsActive(true);
    return s;
}

void Tsy_WizData::SetAllBlksIsActive(bool on)
{
    for (auto& b : blocks_)
        b->active = on;
}

void Tsy_WizData::SetAllSigsIsActive(bool on)
{
    for (auto& s : signals_)
        s->SetIsActive(on);
}
