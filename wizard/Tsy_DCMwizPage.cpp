#include "wizard/Tsy_DCMwizPage.h"

#include "lib/Tsy_PrimitiveLibrary.h"
#include "port/UtStr.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_Vocabulary.h"

#include <QComboBox>

Tsy_DCMwizPage::Tsy_DCMwizPage(Tsy_DCMwiz* wizard, int instNum)
    : Tsy_WizPage(wizard), instNum_(instNum), dcmWiz_(wizard)
{
}

Tsy_DCMwizPage::~Tsy_DCMwizPage() = default;

int Tsy_DCMwizPage::GetWizType() const
{
    return dcmWiz_ ? dcmWiz_->GetWizTypeInt() : 0;
}

Tsy_WizData* Tsy_DCMwizPage::GetWizData() const
{
    return dcmWiz_ ? dcmWiz_->GetDesignData() : nullptr;
}

Tsy_SpeedData* Tsy_DCMwizPage::GetSpeedData() const
{
    return dcmWiz_ ? dcmWiz_->GetSpdDataPtr() : nullptr;
}

StringBase Tsy_DCMwizPage::GetFamily() const
{
    return dcmWiz_ ? dcmWiz_->GetFamilyName() : StringBase();
}

bool Tsy_DCMwizPage::IsBatch() const
{
    return dcmWiz_ && dcmWiz_->IsBatch();
}

Tsy_Block* Tsy_DCMwizPage::GetActiveDCMBlk(int instNum, bool showMessage)
{
    return dcmWiz_ ? dcmWiz_->GetActiveDCMBlk(instNum, showMessage) : nullptr;
}

Tsy_Block* Tsy_DCMwizPage::GetActivePLLBlk(bool showMessage)
{
    return dcmWiz_ ? dcmWiz_->GetActivePLLBlk(showMessage) : nullptr;
}

Tsy_Block* Tsy_DCMwizPage::GetActivePMCDBlk(int instNum)
{
    return dcmWiz_ ? dcmWiz_->GetActivePMCDBlk(instNum) : nullptr;
}

Tsy_StrArray Tsy_DCMwizPage::ValueListOf(const Tsy_Block* block, const StringBase& attribute)
{
    Tsy_StrArray list;
    if (!block)
        return list;
    if (const Tsy_Attribute* a = block->GetNamedAttribute(attribute); a && a->GetDef())
        return a->GetValueList();
    if (const Tsy_AttrDef* def = block->GetDef() ? block->GetDef()->FindAttr(attribute.str()) : nullptr)
        for (const auto& v : def->values)
            list.Add(v);
    return list;
}

const Tsy_StrArray& Tsy_DCMwizPage::GetDcmValueList(int which)
{
    workList_.Empty();
    static const char* const names[] = {Tsy_Attr::CLKDV_DIVIDE, Tsy_Attr::CLKOUT_PHASE_SHIFT, Tsy_Attr::DESKEW_ADJUST};
    Tsy_WizData* data = GetWizData();
    if (!data || which < 0 || which > 2)
        return workList_;
    StringBase type = dcmWiz_->GetDCMPrimName();
    const Tsy_Block* block = data->GetNamedBlock(StringBase::Printf("%s_INST", type.c_str()));
    if (!block)
        block = data->GetPrimitiveBlock(type);
    workList_ = ValueListOf(block, names[which]);
    return workList_;
}

void Tsy_DCMwizPage::FillComboBox(QComboBox* combo, const Tsy_StrArray& items)
{
    if (!combo)
        return;
    combo->clear();
    for (const auto& s : items.Items())
        combo->addItem(QString::fromStdString(s.str()));
}

int Tsy_DCMwizPage::InstNumOf(const Tsy_Block* block)
{
    int n = 0;
    return block && UT_STR::ParseInt(block->GetAttributeValue(Tsy_Attr::TESY_ONLY_INST_NUM), n) ? n : 0;
}

// The 180-degree partner of a forwarded clock.
static StringBase partnerOf(const StringBase& c0)
{
    if (c0.EqualsNoCase("CLK0"))
        return "CLK180";
    if (c0.EqualsNoCase("CLK2X"))
        return "CLK2X180";
    if (c0.EqualsNoCase("CLKFX"))
        return "CLKFX180";
    return StringBase();
}

void Tsy_DCMwizPage::GetApplicationClockOutputs(const Tsy_Block* block, int wizType, bool ddrClockOnly,
                                                StringBase& first, StringBase& second)
{
    first = StringBase();
    second = StringBase();
    if (!block)
        return;
    int inst = InstNumOf(block);
    if (wizType == Tsy_DCMwiz::TypeClockForwarding || (wizType == Tsy_DCMwiz::TypeBoardDeskew && inst == 1)) {
        if (ddrClockOnly) {
            first = block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_CLK);
            return;
        }
        first = block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_C0);
        if (!block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_C1).EqualsNoCase("INVERSION"))
            second = partnerOf(first);
    } else if (wizType == Tsy_DCMwiz::TypeClockSwitching) {
        first = block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DCM_SWITCHING_CLK);
    } else if (wizType == Tsy_DCMwiz::TypeCascading && inst == 1) {
        first = block->GetAttributeValue(Tsy_Attr::TESY_ONLY_CASCADING_CLK);
    } else if (wizType == Tsy_DCMwiz::TypeDcmToPll) {
        first = block->GetAttributeValue(Tsy_Attr::TSY_DCM2PLL_CLKOUT);
    }
}

bool Tsy_DCMwizPage::IsFeedbackSharedWithAppClock(const Tsy_Block* block, int wizType)
{
    if (!block || !block->GetAttributeValue(Tsy_Attr::FB_SOURCE).EqualsNoCase("INTERNAL"))
        return false;
    StringBase fbOut = block->GetAttributeValue(Tsy_Attr::CLK_FEEDBACK).EqualsNoCase("1X") ? "CLK0" : "CLK2X";
    auto same = [&](const char* attr) { return block->GetAttributeValue(attr).EqualsNoCase(fbOut); };
    switch (wizType) {
    case Tsy_DCMwiz::TypeClockSwitching:
        return same(Tsy_Attr::TESY_ONLY_DCM_SWITCHING_CLK);
    case Tsy_DCMwiz::TypeClockForwarding:
        return same(Tsy_Attr::TESY_ONLY_DDR_CLK) || same(Tsy_Attr::TESY_ONLY_DDR_C0);
    case Tsy_DCMwiz::TypeCascading:
        return InstNumOf(block) == 1 && same(Tsy_Attr::TESY_ONLY_CASCADING_CLK);
    default:
        return false;
    }
}

int Tsy_DCMwizPage::GetHighestBufferIndex(const Tsy_Pin* pin)
{
    if (!pin)
        return 0;
    const StringBase prefix(Tsy_Attr::TSY_CLKBUFTYPE);
    int highest = 0;
    for (const auto& a : pin->Attributes()) {
        const StringBase& name = a->GetName();
        if (!name.StartsWith(prefix))
            continue;
        // The whole number after the prefix: a pin may carry ten buffers or more.
        StringBase digits = name.Mid(prefix.GetLength());
        int n = 0;
        if (UT_STR::ParseInt(digits, n) && UT_STR::IsDigit(digits[0]) && n > highest)
            highest = n;
    }
    return highest;
}
