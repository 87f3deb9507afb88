#include "pages/dcm/Tsy_DCMgenSetup.h"

#include "pages/dcm/Tsy_DCMgenSetupGui.h"
#include "port/UtStr.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_Family.h"
#include "wizard/Tsy_SpeedData.h"
#include "wizard/Tsy_Vocabulary.h"

#include <cfloat>
#include <cmath>
#include <new>
#include <vector>

namespace {

const char* const kPinNames[Tsy_DCMgenSetup::PinCount] = {
    "RST",   "PSEN",  "PSINCDEC", "PSCLK", "CLK0",     "CLKFB",  "CLK90",  "CLK180", "CLK270",
    "CLKDV", "CLK2X", "CLK2X180", "CLKFX", "CLKFX180", "STATUS", "LOCKED", "PSDONE",
};

const char* const kReconfigPins[] = {"DADDR", "DI", "DWE", "DEN", "DCLK", "DRDY"};

bool isTrue(const StringBase& v)
{
    return v.EqualsNoCase("TRUE");
}

const char* boolText(bool on)
{
    return on ? "TRUE" : "FALSE";
}

// Entries far beyond any clock still have to compare safely with the speed
// data, which is held as float.
float toFloat(double v)
{
    if (!std::isfinite(v))
        return 0.0f;
    if (v > FLT_MAX)
        return FLT_MAX;
    if (v < -FLT_MAX)
        return -FLT_MAX;
    return static_cast<float>(v);
}

// Figures written as text: "%3.3f" of the double itself, so the third
// decimal rounds as the user would round it; nothing infinite gets written.
StringBase figure(double v)
{
    return StringBase::Printf("%3.3f", std::isfinite(v) ? v : 0.0);
}

// ------------------------------------------------------------------ buffers
// A pin's buffers are numbered from 1 without gaps: "TSY_CLKBUFTYPE<n>",
// "TSY_CLKBUFTYPE<n>_NOEDIT" and the "TSY_CLKBUF<n>_..." names of its nets.

struct BufferAttr {
    int index;
    StringBase head; // "TSY_CLKBUFTYPE" or "TSY_CLKBUF"
    StringBase tail; // "", "_NOEDIT", "_O_SIGNAME" ...
    StringBase value;
    bool active;
};

bool parseBufferAttr(const StringBase& name, int& index, StringBase& head, StringBase& tail)
{
    const StringBase typeHead(Tsy_Attr::TSY_CLKBUFTYPE);
    const StringBase netHead("TSY_CLKBUF");
    size_t at;
    if (name.StartsWith(typeHead)) {
        head = typeHead;
        at = typeHead.GetLength();
    } else if (name.StartsWith(netHead)) {
        head = netHead;
        at = netHead.GetLength();
    } else {
        return false;
    }
    size_t end = at;
    while (UT_STR::IsDigit(name[end]))
        ++end;
    if (end == at || end - at > 3)
        return false;
    tail = name.Mid(end);
    if (head == netHead && !tail.StartsWith("_"))
        return false;
    index = UT_STR::AToI(name.Mid(at).Left(end - at));
    return index > 0;
}

// Drops buffer n and moves the later ones down, so the list stays gap-free.
void removeBuffer(Tsy_Pin* pin, int n)
{
    std::vector<BufferAttr> buffers;
    for (const auto& a : pin->Attributes()) {
        BufferAttr b{0, {}, {}, a->GetValue(), a->IsActive()};
        if (parseBufferAttr(a->GetName(), b.index, b.head, b.tail))
            buffers.push_back(b);
    }
    for (const auto& b : buffers)
        pin->RemoveAttribute(StringBase::Printf("%s%d%s", b.head.c_str(), b.index, b.tail.c_str()));
    for (const auto& b : buffers) {
        if (b.index == n)
            continue;
        int m = b.index > n ? b.index - 1 : b.index;
        StringBase name = StringBase::Printf("%s%d%s", b.head.c_str(), m, b.tail.c_str());
        pin->SetAttributeValue(name, b.value);
        pin->SetAttributeIsActive(name, b.active);
    }
}

bool isFeedbackBuffer(const Tsy_Pin* pin, int n)
{
    return pin->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N_NOEDIT, n))
        .EqualsNoCase(Tsy_BufState::FEEDBACK);
}

void removeFeedbackBuffers(Tsy_Pin* pin)
{
    if (!pin)
        return;
    for (int n = Tsy_DCMwizPage::GetHighestBufferIndex(pin); n >= 1; --n)
        if (isFeedbackBuffer(pin, n))
            removeBuffer(pin, n);
}

} // namespace

// ====================================================================== page

Tsy_DCMgenSetup::Tsy_DCMgenSetup(Tsy_DCMwiz* wizard, int wizType, int instNum)
    : Tsy_DCMwizPage(wizard, instNum), wizType_(wizType), family_(wizard ? wizard->GetFamilyName() : StringBase()),
      gen45_(Tsy_Family::IsGeneration45(family_)), membra3e_(Tsy_Family::IsMembra3E(family_))
{
}

Tsy_DCMgenSetup::~Tsy_DCMgenSetup() = default;

const char* Tsy_DCMgenSetup::PinName(int pin)
{
    return pin >= 0 && pin < PinCount ? kPinNames[pin] : "";
}

const char* Tsy_DCMgenSetup::PsTypeName(PsType type)
{
    switch (type) {
    case PsFixed: return "FIXED";
    case PsVariablePositive: return "VARIABLE_POSITIVE";
    case PsVariableCenter: return "VARIABLE_CENTER";
    case PsVariable: return "VARIABLE";
    case PsDirect: return "DIRECT";
    case PsNone:
    case PsUnknown: break;
    }
    return "NONE";
}

Tsy_DCMgenSetup::PsType Tsy_DCMgenSetup::PsTypeFromText(const StringBase& text)
{
    StringBase t = text;
    t.Trim();
    if (t.IsEmpty() || t.EqualsNoCase("NONE"))
        return PsNone;
    if (t.EqualsNoCase("VARIABLE_POS"))
        return PsVariablePositive;
    for (PsType type : {PsFixed, PsVariablePositive, PsVariableCenter, PsVariable, PsDirect})
        if (t.EqualsNoCase(PsTypeName(type)))
            return type;
    return PsUnknown;
}

StringBase Tsy_DCMgenSetup::GetPageTitle() const
{
    if (Tsy_DCMwiz::IsSingleDcmType(wizType_))
        return "General Setup";
    return GetInstNum() == 2 ? "General Setup for INST2" : "General Setup for INST1";
}

StringBase Tsy_DCMgenSetup::GetWindowTitle() const
{
    if (Tsy_DCMwiz::IsSingleDcmType(wizType_))
        return "Corvane Pendra - General Setup";
    return GetInstNum() == 2 ? "Corvane Pendra - General Setup for INST2" : "Corvane Pendra - General Setup for INST1";
}

StringBase Tsy_DCMgenSetup::GetSymbolPrimitive() const
{
    if (gen45_)
        return "DCM_ADV";
    return membra3e_ ? "DCM_SP" : "DCM";
}

bool Tsy_DCMgenSetup::ApplySilently()
{
    if (!LoadFromBlock())
        return false;
    return StoreToBlock(true);
}

bool Tsy_DCMgenSetup::CreateGui(QWidget* parent)
{
    if (IsBatch())
        return false;
    if (gui_)
        return true;
    try {
        gui_ = std::make_unique<Tsy_DCMgenSetupGui>(this, parent);
    } catch (const std::bad_alloc&) {
        gui_.reset();
    }
    if (!gui_) {
        IssueMessage("Internal error: unable to create GUI object", true, false, false);
        return false;
    }
    return true;
}

Gq_WizardPage* Tsy_DCMgenSetup::GetGui()
{
    return gui_.get();
}

// ------------------------------------------------------------- derivations

float Tsy_DCMgenSetup::EffectiveFrequency(const StringBase& text, Units units, bool divideBy2)
{
    double v = 0.0;
    if (!UT_STR::ParseDouble(text, v))
        return 0.0f;
    if (units == UnitsNs)
        v = v == 0.0 ? 0.0 : 1000.0 / v;
    if (divideBy2)
        v /= 2.0;
    return toFloat(v);
}

StringBase Tsy_DCMgenSetup::ClkinPeriodText(const StringBase& text, Units units, bool divideBy2)
{
    double v = 0.0;
    UT_STR::ParseDouble(text, v);
    double period;
    if (units == UnitsMHz) {
        double f = divideBy2 ? v / 2.0 : v;
        period = f == 0.0 ? 0.0 : 1000.0 / f;
    } else {
        period = divideBy2 ? v * 2.0 : v;
    }
    return figure(period);
}

StringBase Tsy_DCMgenSetup::ClkinTextFromPeriod(const StringBase& period, Units units, bool divideBy2)
{
    double p = 0.0;
    UT_STR::ParseDouble(period, p);
    double v;
    if (units == UnitsMHz) {
        v = p == 0.0 ? 0.0 : 1000.0 / p;
        if (divideBy2)
            v *= 2.0;
    } else {
        v = divideBy2 ? p / 2.0 : p;
    }
    return figure(v);
}

int Tsy_DCMgenSetup::GetOutputType() const
{
    bool dll = false;
    for (int p : {PinCLK0, PinCLK90, PinCLK180, PinCLK270, PinCLKDV, PinCLK2X, PinCLK2X180})
        dll = dll || s_.pins[p];
    bool dfs = s_.pins[PinCLKFX] || s_.pins[PinCLKFX180];
    return (dll ? OutputDll : 0) | (dfs ? OutputDfs : 0);
}

bool Tsy_DCMgenSetup::SelectedInHighFrequencyMode() const
{
    switch (GetOutputType()) {
    case OutputDll: return dllMode_ == 2;
    case OutputDfs: return dfsMode_ == 2;
    case OutputBoth: return dllMode_ == 2 || dfsMode_ == 2;
    default: return false;
    }
}

bool Tsy_DCMgenSetup::SelectedWithoutValidRange() const
{
    switch (GetOutputType()) {
    case OutputDll: return dllMode_ == 0;
    case OutputDfs: return dfsMode_ == 0;
    case OutputBoth: return dllMode_ == 0 || dfsMode_ == 0;
    default: return false;
    }
}

bool Tsy_DCMgenSetup::IsResetLogicAllowed() const
{
    return s_.pins[PinRST] && wizType_ != Tsy_DCMwiz::TypePllToDcm &&
           !(wizType_ == Tsy_DCMwiz::TypeCascading && GetInstNum() == 2);
}

StringBase Tsy_DCMgenSetup::FeedbackOutput() const
{
    if (s_.fbSource != FbSourceInternal)
        return StringBase();
    return s_.fbValue == FbValue2X ? "CLK2X" : "CLK0";
}

bool Tsy_DCMgenSetup::Is2XFeedbackRefused() const
{
    return gen45_ || Tsy_Family::IsTaldor2Pro(family_);
}

bool Tsy_DCMgenSetup::IsReservedOutput(int pin) const
{
    const char* name = PinName(pin);
    for (const auto& r : reserved_)
        if (!r.IsEmpty() && r.EqualsNoCase(name))
            return true;
    return false;
}

bool Tsy_DCMgenSetup::IsInputDerived() const
{
    return GetInstNum() == 2 && (wizType_ == Tsy_DCMwiz::TypeBoardDeskew || wizType_ == Tsy_DCMwiz::TypeCascading);
}

bool Tsy_DCMgenSetup::AreUnitsDerived() const
{
    return IsInputDerived() || (GetInstNum() == 2 && wizType_ == Tsy_DCMwiz::TypeClockSwitching);
}

// --------------------------------------------------------------------- load

bool Tsy_DCMgenSetup::LoadFromBlock()
{
    if (!GetWizData() || !GetDCMWiz())
        return false;
    Tsy_Block* block = GetActiveDCMBlk(GetInstNum(), true);
    if (!block)
        return false;

    if (AreUnitsDerived())
        deriveSecondInput(block);

    readSettings(block);

    if (s_.fbValue == FbValue2X && Is2XFeedbackRefused()) {
        IssueMessage("The Feedback Value was set to 2X, which is not allowed.  It will be changed to 1X by the wizard.",
                     false, false, false);
        s_.fbValue = FbValue1X;
    }
    if (wizType_ == Tsy_DCMwiz::TypeCascading && GetInstNum() == 2)
        s_.resetLogic = false;

    Tsy_DCMwiz* wiz = GetDCMWiz();
    StringBase trimmed = s_.clkinText;
    trimmed.Trim();
    if (wiz->IsLoadedDesign() && trimmed.IsEmpty())
        s_.clkinText = ClkinTextFromPeriod(block->GetAttributeValue(Tsy_Attr::CLKIN_PERIOD), s_.units, s_.divideBy2);

    GetApplicationClockOutputs(block, wizType_, false, reserved_[0], reserved_[1]);
    for (int p = 0; p < PinCount; ++p) {
        const char* name = p == PinSTATUS && gen45_ ? "DO" : PinName(p);
        const Tsy_Pin* pin = block->GetNamedPin(name);
        s_.pins[p] = pin && pin->IsActive();
        if (IsReservedOutput(p))
            s_.pins[p] = true;
    }

    s_.pmcdAvailable = false;
    if (Tsy_Family::Is(family_, "taldor5") && wiz->IsRetarget()) {
        s_.pmcdAvailable = true;
        block->SetAttributeValue(Tsy_Attr::TESY_ONLY_RETARGET, "T4TOT5");
    } else if (Tsy_Family::IsGeneration4(family_) && wizType_ == Tsy_DCMwiz::TypeDcm && wiz->IsPmcdFamily()) {
        s_.pmcdAvailable = true;
    }

    if (wiz->IsDefaultSetup() && !wiz->IsLoadedDesign() && !defaultSetupDone_) {
        s_.pins[PinCLK0] = true;
        s_.clkinText = "100";
        defaultSetupDone_ = true;
    }

    tidyBlock(block);

    // The frequency modes decide whether a phase shift is possible at all.
    // A batch run says so when it drops one; the page shows it in its form.
    ComputeFrequencyModes(s_.clkinText, s_.pins[PinCLK2X] || s_.pins[PinCLK2X180], s_.units);
    RestrictPhaseShift(IsBatch());
    ComputePhaseShiftLimits();
    ComputePhaseShiftDisplay();
    return true;
}

void Tsy_DCMgenSetup::readSettings(Tsy_Block* block)
{
    auto get = [block](const char* name) { return block->GetAttributeValue(name); };

    s_.clkinText = get(Tsy_Attr::TESY_ONLY_CLKIN_VALUE);
    s_.units = get(Tsy_Attr::FIN_UNITS).EqualsNoCase("MHZ") ? UnitsMHz : UnitsNs;
    s_.clkdvDivide = get(Tsy_Attr::CLKDV_DIVIDE);
    StringBase ps = get(Tsy_Attr::CLKOUT_PHASE_SHIFT);
    s_.psType = PsTypeFromText(ps);
    s_.psTypeText = s_.psType == PsUnknown ? ps : StringBase();
    s_.psValue = get(Tsy_Attr::PHASE_SHIFT);
    if (s_.psValue.IsEmpty())
        s_.psValue = "0";
    s_.dutyCycle = isTrue(get(Tsy_Attr::DUTY_CYCLE_CORRECTION));
    // Families without performance modes carry no such attribute.
    StringBase perf = get(Tsy_Attr::DCM_PERFORMANCE_MODE);
    if (!perf.IsEmpty())
        s_.perfMode = perf.EqualsNoCase("MAX_SPEED") ? PerfMaxSpeed : PerfMaxRange;

    StringBase fbValue = get(Tsy_Attr::CLK_FEEDBACK);
    if (fbValue.EqualsNoCase("1X"))
        s_.fbValue = FbValue1X;
    else if (fbValue.EqualsNoCase("NONE"))
        s_.fbValue = FbValueNone;
    else
        s_.fbValue = FbValue2X;
    StringBase fbSource = get(Tsy_Attr::FB_SOURCE);
    if (fbSource.EqualsNoCase("NONE"))
        s_.fbSource = FbSourceNone;
    else if (fbSource.EqualsNoCase("INTERNAL"))
        s_.fbSource = FbSourceInternal;
    else
        s_.fbSource = FbSourceExternal;
    StringBase fbExternal = get(Tsy_Attr::TESY_ONLY_FB_EXTERNAL);
    if (fbExternal.EqualsNoCase("SINGLE"))
        s_.fbDifferential = false;
    else if (fbExternal.EqualsNoCase("DIFFERENTIAL"))
        s_.fbDifferential = true;

    s_.clkinInternal = get(Tsy_Attr::CLKIN_SRC_TYPE).EqualsNoCase("INTERNAL");
    s_.clkinDifferential = get(Tsy_Attr::TESY_ONLY_CLKIN_EXTERNAL).EqualsNoCase("DIFFERENTIAL");
    s_.divideBy2 = isTrue(get(Tsy_Attr::CLKIN_DIVIDE_BY_2));
    s_.startupWait = isTrue(get(Tsy_Attr::STARTUP_WAIT));
    s_.deskewAdjust = get(Tsy_Attr::DESKEW_ADJUST);
    s_.resetLogic = isTrue(get(Tsy_Attr::TESY_ONLY_RESET_LOGIC));
    StringBase reconfig = get(Tsy_Attr::TESY_ONLY_RECONFIG_PINS);
    if (!reconfig.IsEmpty())
        s_.reconfigPins = isTrue(reconfig);
    s_.pmcdMode = get(Tsy_Attr::TESY_ONLY_PMCD);
    s_.pmcdSelected = s_.pmcdMode.EqualsNoCase("SINGLE") || s_.pmcdMode.EqualsNoCase("PARALLEL");
}

// The second DCM of board deskew sees the board clock the first one sees; the
// second of a cascade sees the first one's cascading output.
void Tsy_DCMgenSetup::deriveSecondInput(Tsy_Block* second)
{
    Tsy_Block* first = GetActiveDCMBlk(1, false);
    if (!first || first == second)
        return;
    StringBase units = first->GetAttributeValue(Tsy_Attr::FIN_UNITS);
    // Clock switching keeps its own input; when the units change under it,
    // the value is converted so that it still names the same clock.
    if (wizType_ == Tsy_DCMwiz::TypeClockSwitching) {
        StringBase own = second->GetAttributeValue(Tsy_Attr::FIN_UNITS);
        bool ownMHz = own.EqualsNoCase("MHZ");
        bool firstMHz = units.EqualsNoCase("MHZ");
        double v = 0.0;
        if (ownMHz != firstMHz && UT_STR::ParseDouble(second->GetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE), v))
            second->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE, figure(v == 0.0 ? 0.0 : 1000.0 / v));
    }
    second->SetAttributeValue(Tsy_Attr::FIN_UNITS, units);

    if (wizType_ == Tsy_DCMwiz::TypeBoardDeskew) {
        second->SetAttributeValue(Tsy_Attr::CLKIN_PERIOD, first->GetAttributeValue(Tsy_Attr::CLKIN_PERIOD));
        second->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE,
                                  first->GetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE));
        return;
    }
    if (wizType_ != Tsy_DCMwiz::TypeCascading)
        return;

    const bool mhz = units.EqualsNoCase("MHZ");
    double v = 0.0;
    UT_STR::ParseDouble(first->GetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE), v);
    // Every output of the first DCM runs at its input after its own divider.
    if (isTrue(first->GetAttributeValue(Tsy_Attr::CLKIN_DIVIDE_BY_2)))
        v = mhz ? v / 2.0 : v * 2.0;
    StringBase clk = first->GetAttributeValue(Tsy_Attr::TESY_ONLY_CASCADING_CLK);
    if (clk.EqualsNoCase("CLKDV")) {
        double divide = 0.0;
        if (UT_STR::ParseDouble(first->GetAttributeValue(Tsy_Attr::CLKDV_DIVIDE), divide) && divide > 0.0)
            v = mhz ? v / divide : v * divide;
    } else if (clk.EqualsNoCase("CLK2X") || clk.EqualsNoCase("CLK2X180")) {
        v = mhz ? v * 2.0 : v / 2.0;
    }
    StringBase text = figure(v);
    second->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE, text);
    second->SetAttributeValue(
        Tsy_Attr::CLKIN_PERIOD,
        ClkinPeriodText(text, mhz ? UnitsMHz : UnitsNs, isTrue(second->GetAttributeValue(Tsy_Attr::CLKIN_DIVIDE_BY_2))));
}

void Tsy_DCMgenSetup::tidyBlock(Tsy_Block* block)
{
    if (Tsy_WizData* data = GetWizData()) {
        std::vector<Tsy_Block*> pmcds;
        if (s_.pmcdMode.EqualsNoCase("SINGLE")) {
            Tsy_Block* pmcd = data->GetActiveBlock("PMCD");
            pmcds.push_back(pmcd ? pmcd : data->GetPrimitiveBlock("PMCD"));
        } else if (s_.pmcdMode.EqualsNoCase("PARALLEL")) {
            pmcds.push_back(data->GetBlockInstNum("PMCD", 1));
            pmcds.push_back(data->GetBlockInstNum("PMCD", 2));
        }
        for (Tsy_Block* pmcd : pmcds)
            if (pmcd)
                pmcd->RemoveAttribute("SIM_X_INPUT");
    }
    if (Tsy_Pin* drst = block->GetNamedPin("DRST"))
        block->DeletePin(drst);
    if (Tsy_Pin* daddr = block->GetNamedPin("DADDR"))
        daddr->SetWidth(7);
    block->RemoveAttribute("CLK_OUTPUT_TYPE");
    // Where the application's own buffer closes the loop, a feedback buffer
    // of this page would be a second one.
    if (s_.fbSource == FbSourceInternal && IsFeedbackSharedWithAppClock(block, wizType_))
        removeFeedbackBuffers(block->GetNamedPin(FeedbackOutput()));
    for (const auto& pin : block->Pins())
        for (int n = 1; n <= 19; ++n) {
            StringBase name = StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N_NOEDIT, n);
            if (pin->GetAttributeValue(name).EqualsNoCase(Tsy_BufState::FIXED))
                pin->RemoveAttribute(name);
        }
}

// -------------------------------------------------------------- phase shift

void Tsy_DCMgenSetup::ComputePhaseShiftLimits()
{
    StringBase text = s_.clkinText;
    text.Trim();
    if (text.IsEmpty() || s_.psType == PsNone)
        return;
    if (s_.psType == PsDirect) {
        psLowest_ = 0;
        psHighest_ = 1023;
        return;
    }
    const bool maxSpeed = gen45_ && s_.perfMode == PerfMaxSpeed;
    double range;
    switch (s_.psType) {
    case PsFixed:
    case PsVariablePositive: range = maxSpeed ? 7.0 : 10.0; break;
    case PsVariable:
    case PsVariableCenter: range = maxSpeed ? 3.0 : (membra3e_ ? 10.0 : 5.0); break;
    default: range = 0.0; break;
    }
    if (s_.psType == PsFixed && membra3e_) {
        psLowest_ = -255;
        psHighest_ = 255;
        return;
    }
    // Without a usable input frequency there is no period to measure against.
    float f = EffectiveFrequency(s_.clkinText, s_.units, s_.divideBy2);
    if (!(f > 0.0f))
        return;
    double period = 1000.0 / f;
    double steps = 256.0 * range / period;
    int highest = steps >= 255.0 ? 255 : static_cast<int>(std::trunc(steps));
    psHighest_ = highest;
    psLowest_ = s_.psType == PsVariablePositive ? 0 : -highest;
}

void Tsy_DCMgenSetup::ComputePhaseShiftDisplay()
{
    int value = 0;
    UT_STR::ParseInt(s_.psValue, value);
    ComputePhaseShiftDisplay(value);
}

void Tsy_DCMgenSetup::ComputePhaseShiftDisplay(int value)
{
    float f = EffectiveFrequency(s_.clkinText, s_.units, s_.divideBy2);
    double period = f > 0.0f ? 1000.0 / f : 0.0;
    if (s_.psType == PsDirect) {
        // DIRECT counts delay taps of 25 ps; the angle is that delay against
        // the input period.
        psNs_ = 0.025 * value;
        psDegrees_ = period > 0.0 ? 360.0 * psNs_ / period : 0.0;
    } else {
        psDegrees_ = 360.0 * value / 256.0;
        psNs_ = period * value / 256.0;
    }
}

bool Tsy_DCMgenSetup::RestrictPhaseShift(bool warn)
{
    const bool highFrequency = (membra3e_ || Tsy_Family::IsMembra3(family_)) && SelectedInHighFrequencyMode();
    if (highFrequency) {
        if (warn && s_.psType != PsNone)
            IssueMessage("Fixed or Variable phase shifting is not supported when the DFS/DLL frequency mode is set to "
                         "high.  The phase shift will automatically be set to 'None'.",
                         false, false, false);
        s_.psType = PsNone;
        s_.psTypeText = StringBase();
        s_.psValue = "0";
        return true;
    }
    // A missing input only holds the phase shift until there is one again;
    // what the user set stays.
    StringBase text = s_.clkinText;
    text.Trim();
    return text.IsEmpty() || !(EffectiveFrequency(s_.clkinText, s_.units, s_.divideBy2) > 0.0f);
}

// -------------------------------------------------------------------- store

bool Tsy_DCMgenSetup::StoreToBlock(bool validate)
{
    if (!GetWizData() || !GetDCMWiz())
        return false;
    Tsy_Block* block = GetActiveDCMBlk(GetInstNum(), true);
    if (!block)
        return false;
    settleDerivedSettings();
    if (validate) {
        if (!ValidatePage(block))
            return false;
    } else {
        ComputeFrequencyModes(s_.clkinText, s_.pins[PinCLK2X] || s_.pins[PinCLK2X180], s_.units);
    }
    activateBlock(block);
    storeInputFrequency(block);
    storeOutputShaping(block);
    storeClockSources(block);
    storeStartupOptions(block);
    if (gen45_)
        storeGeneration45Options(block);
    block->SetAttributeValue(Tsy_Attr::TESY_ONLY_RESET_LOGIC, boolText(s_.resetLogic));
    storeFrequencyModes(block);
    storeFamilyAttributes(block);
    storePins(block);
    storeFeedbackMarks(block);
    return true;
}

// The pins and values that follow from other settings.
void Tsy_DCMgenSetup::settleDerivedSettings()
{
    const bool dynamicPs = s_.psType != PsNone && s_.psType != PsFixed;
    s_.pins[PinPSEN] = s_.pins[PinPSINCDEC] = s_.pins[PinPSCLK] = s_.pins[PinPSDONE] = dynamicPs;
    s_.pins[PinCLKFB] = s_.fbSource != FbSourceNone;
    if (s_.fbSource != FbSourceNone && s_.fbValue == FbValueNone)
        s_.fbValue = FbValue1X;
    if (!IsResetLogicAllowed())
        s_.resetLogic = false;
}

void Tsy_DCMgenSetup::activateBlock(Tsy_Block* block)
{
    // In a single-DCM design Finish builds the rest of the netlist anew
    // around this block.
    if (wizType_ == Tsy_DCMwiz::TypeDcm) {
        Tsy_WizData* data = GetWizData();
        data->SetAllBlksIsActive(false);
        data->SetAllSigsIsActive(false);
    }
    block->active = true;
}

void Tsy_DCMgenSetup::storeInputFrequency(Tsy_Block* block)
{
    block->SetAttributeValue(Tsy_Attr::CLKIN_PERIOD, ClkinPeriodText(s_.clkinText, s_.units, s_.divideBy2));
    block->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE, s_.clkinText);
    const char* units = s_.units == UnitsMHz ? "MHZ" : "NS";
    block->SetAttributeValue(Tsy_Attr::FIN_UNITS, units);
    if (!GetDCMWiz()->IsLoadedDesign())
        block->SetAttributeValue(Tsy_Attr::FOUT_UNITS, units);
}

// The CLKDV divider, the phase shift and the duty-cycle correction.
void Tsy_DCMgenSetup::storeOutputShaping(Tsy_Block* block)
{
    block->SetAttributeValue(Tsy_Attr::CLKDV_DIVIDE, s_.clkdvDivide);
    block->SetAttributeValue(Tsy_Attr::CLKOUT_PHASE_SHIFT,
                             s_.psType == PsUnknown ? s_.psTypeText : StringBase(PsTypeName(s_.psType)));
    int psValue = 0;
    block->SetAttributeValue(Tsy_Attr::PHASE_SHIFT,
                             UT_STR::ParseInt(s_.psValue, psValue) ? StringBase::Printf("%d", psValue) : s_.psValue);
    block->SetAttributeValue(Tsy_Attr::DUTY_CYCLE_CORRECTION, boolText(s_.dutyCycle));
}

// Where the feedback and the input clock come from, and how they arrive.
void Tsy_DCMgenSetup::storeClockSources(Tsy_Block* block)
{
    if (s_.fbSource == FbSourceNone) {
        block->SetAttributeValue(Tsy_Attr::FB_SOURCE, "NONE");
        block->SetAttributeValue(Tsy_Attr::CLK_FEEDBACK, "NONE");
    } else {
        block->SetAttributeValue(Tsy_Attr::FB_SOURCE, s_.fbSource == FbSourceInternal ? "INTERNAL" : "EXTERNAL");
        block->SetAttributeValue(Tsy_Attr::CLK_FEEDBACK, s_.fbValue == FbValue2X ? "2X" : "1X");
    }
    block->SetAttributeValue(Tsy_Attr::TESY_ONLY_FB_EXTERNAL, s_.fbDifferential ? "DIFFERENTIAL" : "SINGLE");
    block->SetAttributeValue(Tsy_Attr::CLKIN_SRC_TYPE, s_.clkinInternal ? "INTERNAL" : "EXTERNAL");
    block->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_EXTERNAL, s_.clkinDifferential ? "DIFFERENTIAL" : "SINGLE");
    block->SetAttributeValue(Tsy_Attr::CLKIN_DIVIDE_BY_2, boolText(s_.divideBy2));
}

void Tsy_DCMgenSetup::storeStartupOptions(Tsy_Block* block)
{
    block->SetAttributeValue(Tsy_Attr::STARTUP_WAIT, boolText(s_.startupWait));
    block->SetAttributeValue(Tsy_Attr::DESKEW_ADJUST, s_.deskewAdjust);
    static const char* const outputTypes[] = {"", "DLL", "FX", "DLL_AND_FX"};
    block->SetAttributeValue(Tsy_Attr::TSY_CLK_OUTPUT_TYPE, outputTypes[GetOutputType()]);
}

void Tsy_DCMgenSetup::storeGeneration45Options(Tsy_Block* block)
{
    if (s_.pmcdAvailable && !s_.pmcdSelected)
        block->SetAttributeValue(Tsy_Attr::TESY_ONLY_PMCD, "NONE");
    else if (s_.pmcdSelected && !s_.pmcdMode.EqualsNoCase("SINGLE") && !s_.pmcdMode.EqualsNoCase("PARALLEL"))
        block->SetAttributeValue(Tsy_Attr::TESY_ONLY_PMCD, "SINGLE");
    block->SetAttributeValue(Tsy_Attr::DCM_AUTOCALIBRATION, "TRUE");
    block->SetAttributeValue(Tsy_Attr::TESY_ONLY_RECONFIG_PINS, boolText(s_.reconfigPins));
    block->SetAttributeValue(Tsy_Attr::DCM_PERFORMANCE_MODE, s_.perfMode == PerfMaxRange ? "MAX_RANGE" : "MAX_SPEED");
}

void Tsy_DCMgenSetup::storeFrequencyModes(Tsy_Block* block)
{
    const char* dfsMode = dfsMode_ == 2 ? "HIGH" : "LOW";
    block->SetAttributeValue(Tsy_Attr::DLL_FREQUENCY_MODE, dllMode_ == 2 ? "HIGH" : "LOW");
    block->SetAttributeValue(Tsy_Attr::DFS_FREQUENCY_MODE, dfsMode);
    block->SetAttributeValue(Tsy_Attr::TESY_ONLY_VALID_DFS_MODE, dfsMode_ == 3 ? "BOTH" : dfsMode);
}

void Tsy_DCMgenSetup::storeFamilyAttributes(Tsy_Block* block)
{
    const char* jf;
    if (Tsy_Family::IsMembra3(family_))
        jf = "16'h8080";
    else if ((dllMode_ == 1 || dllMode_ == 3) && !gen45_)
        jf = "16'hC080";
    else
        jf = "16'hF0F0";
    block->AddAttribute(Tsy_Attr::FACTORY_JF, jf);
    if (Tsy_Family::Is(family_, "taldor5"))
        block->AddAttribute(Tsy_Attr::SIM_DEVICE, "TALDOR5");
}

void Tsy_DCMgenSetup::storePins(Tsy_Block* block)
{
    for (int p = 0; p < PinCount; ++p) {
        bool on = s_.pins[p];
        const char* name = PinName(p);
        if (p == PinSTATUS && gen45_) {
            // DCM_ADV reports its status on DO, which is also the read-back
            // port of dynamic reconfiguration.
            name = "DO";
            on = on || s_.reconfigPins;
        }
        if (Tsy_Pin* pin = block->GetNamedPin(name))
            pin->SetIsActive(on);
    }
    if (!gen45_)
        return;
    for (const char* name : kReconfigPins)
        if (Tsy_Pin* pin = block->GetNamedPin(name))
            pin->SetIsActive(s_.reconfigPins);
    if (Tsy_Pin* dssen = block->GetNamedPin("DSSEN")) {
        dssen->SetIsActive(false);
        dssen->SetIsGrounded(true);
    }
}

void Tsy_DCMgenSetup::storeFeedbackMarks(Tsy_Block* block)
{
    StringBase loop = FeedbackOutput();
    if (!loop.IsEmpty() && IsFeedbackSharedWithAppClock(block, wizType_))
        loop = StringBase();
    for (const char* name : {"CLK0", "CLK2X"}) {
        Tsy_Pin* pin = block->GetNamedPin(name);
        if (!pin)
            continue;
        if (!loop.EqualsNoCase(name)) {
            removeFeedbackBuffers(pin);
            continue;
        }
        bool marked = false;
        for (int n = 1; n <= 15 && !marked; ++n)
            marked = isFeedbackBuffer(pin, n);
        if (!marked) {
            int n = GetHighestBufferIndex(pin) + 1;
            pin->SetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N, n), "BUFG");
            pin->SetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N_NOEDIT, n), Tsy_BufState::FEEDBACK);
        }
        pin->SetIsActive(true);
    }
}
