#include "support/NetlistView.h"

#include <algorithm>

const Tsy_Block* NetlistView::Block(const std::string& name) const
{
    for (const auto& b : data_.Blocks())
        if (b->active && b->GetName() == name)
            return b.get();
    return nullptr;
}

std::string NetlistView::TypeOf(const std::string& block) const
{
    const Tsy_Block* b = Block(block);
    return b ? b->GetType().str() : std::string();
}

std::string NetlistView::On(const std::string& block, const std::string& pin) const
{
    const Tsy_Block* b = Block(block);
    const Tsy_Pin* p = b ? b->GetNamedPin(pin) : nullptr;
    if (!p)
        return "(none)";
    if (!p->IsActive())
        return "(inactive)";
    if (p->IsGrounded())
        return "GND";
    if (p->IsVcc())
        return "VCC";
    return p->GetSigName().str();
}

std::string NetlistView::Kind(const std::string& signal) const
{
    const Tsy_Signal* s = data_.GetNamedSignal(signal);
    if (!s || !s->IsActive())
        return "";
    if (!s->IsExternal())
        return "net";
    return s->GetDirection() == "I" ? "in" : "out";
}

std::string NetlistView::Attr(const std::string& signal, const std::string& attr) const
{
    const Tsy_Signal* s = data_.GetNamedSignal(signal);
    return s ? s->GetAttributeValue(attr).str() : std::string();
}

int NetlistView::Width(const std::string& signal) const
{
    const Tsy_Signal* s = data_.GetNamedSignal(signal);
    return s ? s->GetWidth() : 0;
}

std::vector<std::string> NetlistView::Blocks() const
{
    std::vector<std::string> out;
    for (const auto& b : data_.Blocks())
        if (b->active)
            out.push_back(b->GetName().str() + ":" + b->GetType().str());
    std::sort(out.begin(), out.end());
    return out;
}

std::vector<std::string> NetlistView::Ports() const
{
    std::vector<std::string> out;
    for (const auto& s : data_.Signals())
        if (s->IsActive() && s->IsExternal())
            out.push_back(s->GetName().str() + (s->GetDirection() == "I" ? ":in" : ":out"));
    std::sort(out.begin(), out.end());
    return out;
}

int NetlistView::Count(const std::string& type) const
{
    int n = 0;
    for (const auto& b : data_.Blocks())
        n += b->active && b->GetType() == type;
    return n;
}
