// The checks run when the user leaves General Setup forward (and by every
// batch run): the input frequency against the speed-file ranges, then the
// outputs, the feedback, the phase shift and the startup options.

#include "pages/dcm/Tsy_DCMgenSetup.h"

#include "hdl/Tsy_HdlNames.h"
#include "port/UtStr.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_Family.h"
#include "wizard/Tsy_SpeedData.h"
#include "wizard/Tsy_Vocabulary.h"

namespace {

// The stepping-0 synthesizer input range of the devices that have one.
constexpr int kStepping0Min = 5;
constexpr int kStepping0Max = 90;

bool isDll(int outputType)
{
    return outputType == Tsy_DCMgenSetup::OutputDll || outputType == Tsy_DCMgenSetup::OutputBoth;
}

bool isDfs(int outputType)
{
    return outputType == Tsy_DCMgenSetup::OutputDfs || outputType == Tsy_DCMgenSetup::OutputBoth;
}

// Begins with a letter and holds nothing but letters, digits and '_'.
bool isLettersDigitsAndUnderscores(const StringBase& name)
{
    bool legal = UT_STR::IsAlpha(name[0]);
    for (size_t i = 0; legal && i < name.GetLength(); ++i)
        legal = UT_STR::IsAlpha(name[i]) || UT_STR::IsDigit(name[i]) || name[i] == '_';
    return legal;
}

} // namespace

int Tsy_DCMgenSetup::ClassifyFrequency(float f, float lowMin, float lowMax, float highMin, float highMax)
{
    // No clock runs at zero or below, whatever an empty range of the speed
    // data (0 - 0) would say.
    if (!(f > 0.0f))
        return 0;
    bool low = lowMin <= f && f <= lowMax;
    bool high = highMin <= f && f <= highMax;
    return (low ? 1 : 0) | (high ? 2 : 0);
}

float Tsy_DCMgenSetup::speed(const char* keyPattern, const char* fill)
{
    Tsy_SpeedData* data = GetSpeedData();
    return data ? data->GetSpeedValue(StringBase::Printf(keyPattern, fill)) : 0.0f;
}

void Tsy_DCMgenSetup::LoadFrequencyRanges(bool doubledOutput)
{
    const char* infix = "";
    if (gen45_) {
        infix = s_.perfMode == PerfMaxRange ? "MR_" : "MS_";
        if (Tsy_SpeedData* data = GetSpeedData())
            data->SetPerformanceMode(s_.perfMode == PerfMaxRange ? Tsy_SpeedData::MaxRange : Tsy_SpeedData::MaxSpeed);
    }
    ranges_.dllLowMin = speed("CLKIN_FREQ_DLL_LF_%sMin", infix);
    ranges_.dllLowMax = speed("CLKIN_FREQ_DLL_LF_%sMax", infix);
    ranges_.dfsLowMin = speed("CLKIN_FREQ_FX_LF_%sMin", infix);
    ranges_.dfsLowMax = speed("CLKIN_FREQ_FX_LF_%sMax", infix);
    ranges_.dllHighMin = speed("CLKIN_FREQ_DLL_HF_%sMin", infix);
    ranges_.dllHighMax = speed("CLKIN_FREQ_DLL_HF_%sMax", infix);
    if (gen45_) {
        ranges_.dfsHighMin = speed("CLKIN_FREQ_FX_HF_%sMin", infix);
        ranges_.dfsHighMax = speed("CLKIN_FREQ_FX_HF_%sMax", infix);
    } else {
        ranges_.dfsHighMin = speed("CLKIN_FRQ_FX_HF_%sMin", infix);
        ranges_.dfsHighMax = speed("CLKIN_FRQ_FX_HF_%sMax", infix);
    }
    // A doubled output of the first DCM of a cascade runs the second one at
    // twice the input.
    if (wizType_ == Tsy_DCMwiz::TypeCascading && doubledOutput && (!gen45_ || s_.perfMode == PerfMaxSpeed)) {
        ranges_.dllLowMax /= 2.0f;
        ranges_.dfsLowMax /= 2.0f;
    }
}

void Tsy_DCMgenSetup::ComputeFrequencyModes(const StringBase& text, bool doubledOutput, Units units)
{
    inputFreq_ = EffectiveFrequency(text, units, s_.divideBy2);
    LoadFrequencyRanges(doubledOutput);
    const Ranges& r = ranges_;
    dllMode_ = ClassifyFrequency(inputFreq_, r.dllLowMin, r.dllLowMax, r.dllHighMin, r.dllHighMax);
    dfsMode_ = ClassifyFrequency(inputFreq_, r.dfsLowMin, r.dfsLowMax, r.dfsHighMin, r.dfsHighMax);
}

StringBase Tsy_DCMgenSetup::rangeLine(const char* format, float min, float max) const
{
    if (s_.units == UnitsMHz)
        return StringBase::Printf(format, static_cast<double>(min), static_cast<double>(max), "MHz");
    // As periods the smaller figure comes from the larger frequency.
    return StringBase::Printf(format, static_cast<double>(Tsy_SpeedData::FreqToPeriod(max)),
                              static_cast<double>(Tsy_SpeedData::FreqToPeriod(min)), "ns");
}

void Tsy_DCMgenSetup::ReportFrequencyRanges(int reportCase)
{
    if (reportCase < CaseCascadeFirst || reportCase > CaseMaxRange)
        return;
    IssueMessage(rangeReportReason(reportCase) + rangeReportFigures(reportCase), true, false, true);
}

bool Tsy_DCMgenSetup::isMaxRangeMode() const
{
    return gen45_ && s_.perfMode == PerfMaxRange;
}

// Why the input frequency was refused and what to change.
StringBase Tsy_DCMgenSetup::rangeReportReason(int reportCase) const
{
    switch (reportCase) {
    case CaseCascadeFirst:
        return "Only Low Frequency mode is valid for Cascading In Series.\n"
               "Please enter an Input Clock Frequency value within the valid Low Frequency range.\n\n";
    case CaseCascadeSecond:
        return "Only Low Frequency mode is valid for Cascading In Series.\n"
               "The Input Clock Frequency for this DCM is set\n"
               "using the first DCM's Input Clock Frequency.\n"
               "Please adjust that value so this DCM's input frequency\n"
               "falls within the valid Low Frequency range.\n\n";
    case CaseCascadeSecondClkdv:
        return "Only Low Frequency mode is valid for Cascading In Series.\n"
               "The Input Clock Frequency for this DCM is set\n"
               "using the first DCM's Input Clock Frequency and the CLKDV's Divide-By-Value.\n"
               "Please adjust those values so this DCM's input frequency falls\n"
               "within the valid Low Frequency range.\n\n";
    case CaseMaxRange:
        return "Only Low Frequency mode is valid when the Performance Mode is set to Max Range.\n"
               "Please adjust the Performance Mode setting (in the Advanced Dialog)\n"
               "or change the input frequency to be within the valid Low Frequency range.\n\n";
    case CaseDll:
    case CaseDfs:
    case CaseDllAndDfs:
        return outOfRangeReason();
    default:
        return StringBase();
    }
}

// The reason of the DLL and DFS cases, which depends on the performance mode.
StringBase Tsy_DCMgenSetup::outOfRangeReason() const
{
    StringBase text;
    if (isMaxRangeMode())
        text = "A valid Input Clock Frequency value is required to continue.\n"
               "Please enter a value within the valid ranges.\n\n";
    else
        text = "A valid Input Clock Frequency value is required to continue.\n"
               "Please enter a value within the valid ranges.\n"
               "Note: High Frequency mode is set only after Low Frequency\n"
               "maximum has been exceeded.\n\n";
    if (gen45_)
        text += StringBase::Printf("Performance Mode is set to %s.\n\n",
                                   isMaxRangeMode() ? "Maximum Range" : "Maximum Speed");
    return text;
}

// The valid ranges that apply to the case, in the units of the entry.
StringBase Tsy_DCMgenSetup::rangeReportFigures(int reportCase) const
{
    const Ranges& r = ranges_;
    StringBase dllLow = rangeLine("DLL Low Frequency Mode: %3.3f - %3.3f %s\n", r.dllLowMin, r.dllLowMax);
    StringBase dllHigh = rangeLine("DLL High Frequency Mode: %3.3f - %3.3f %s\n", r.dllHighMin, r.dllHighMax);
    StringBase dfsLow = rangeLine("DFS Low Frequency Mode: %3.3f - %3.3f %s\n", r.dfsLowMin, r.dfsLowMax);
    StringBase dfsHigh = rangeLine("DFS High Frequency Mode: %3.3f - %3.3f %s\n", r.dfsHighMin, r.dfsHighMax);
    const StringBase bothLow = dllLow + "\n" + dfsLow;
    const bool maxRange = isMaxRangeMode();
    const int outputs = GetOutputType();
    switch (reportCase) {
    case CaseCascadeFirst:
    case CaseCascadeSecond:
    case CaseCascadeSecondClkdv:
        if (outputs == OutputDfs)
            return dfsLow;
        return outputs == OutputDll ? dllLow : bothLow;
    case CaseDll:
        return maxRange ? dllLow : dllLow + dllHigh;
    case CaseDfs:
        return maxRange ? dfsLow : dfsLow + dfsHigh;
    case CaseDllAndDfs:
        return maxRange ? bothLow : dllLow + dllHigh + "\n" + dfsLow + dfsHigh;
    case CaseMaxRange:
        return bothLow;
    default:
        return StringBase();
    }
}

int Tsy_DCMgenSetup::ask(const StringBase& question, int batchAnswer)
{
    if (IsBatch()) {
        IssueMessage(question, false, false, false);
        return batchAnswer;
    }
    return IssueYesNoQuestion(question, "");
}

// ------------------------------------------------------------------ chain

bool Tsy_DCMgenSetup::ValidatePage(Tsy_Block* block)
{
    if (GetOutputType() == OutputNone) {
        IssueMessage("Please select at least one clock output to continue.", true, false, false);
        return false;
    }
    if (!CheckInstanceName(block))
        return false;
    if (!checkListValues())
        return false;
    ComputeFrequencyModes(s_.clkinText, s_.pins[PinCLK2X] || s_.pins[PinCLK2X180], s_.units);
    if (!checkFrequencyModes())
        return false;
    if (!checkFeedback())
        return false;
    // The output that closes an internal loop runs whether or not it was
    // asked for, and its range counts like any other.
    for (int pin : {PinCLK0, PinCLK2X})
        if (FeedbackOutput() == PinName(pin))
            s_.pins[pin] = true;
    if (s_.pins[PinCLKDV] && !checkOutputRange(true))
        return false;
    if ((s_.pins[PinCLK2X] || s_.pins[PinCLK2X180]) && !checkOutputRange(false))
        return false;
    if (s_.psType != PsNone && !checkPhaseShift())
        return false;
    if (!checkStartupWait())
        return false;
    stepNote();
    if (Tsy_Family::IsGeneration4(family_) && GetOutputType() == OutputDfs && dllMode_ == 0)
        IssueMessage("Because only DFS clocks are used, but the input clock frequency is outside the DLL frequency "
                     "range, a special macro should be used in order for the DCM_ADV to lock properly.  Please "
                     "refer to Answer Record 23624 for details.",
                     false, false, false);
    return true;
}

bool Tsy_DCMgenSetup::CheckInstanceName(Tsy_Block* block)
{
    if (!block)
        return true;
    if (block->GetName().EqualsNoCase("DCM") || block->GetName().EqualsNoCase("DCM_ADV"))
        renameFromPrimitiveName(block);
    bool ok = checkInstanceNameIsLegal(block);
    warnIfModuleNamedAfterPrimitive();
    return ok;
}

void Tsy_DCMgenSetup::renameFromPrimitiveName(Tsy_Block* block)
{
    StringBase prim = gen45_ ? "DCM_ADV" : "DCM";
    StringBase name = freeInstanceName(StringBase::Printf("%s_INST", prim.c_str()), block);
    IssueMessage(StringBase::Printf("The specified DCM Instance Name is the same as the primitive name'%s'.  "
                                    "Since this is not allowed, the instance name will be changed to '%s'.",
                                    prim.c_str(), name.c_str()),
                 false, false, false);
    block->SetName(name);
}

// Another block may hold the name already (a template, say); then the next
// free numbered name is taken, as generation names blocks.
StringBase Tsy_DCMgenSetup::freeInstanceName(const StringBase& wanted, const Tsy_Block* block) const
{
    Tsy_WizData* data = GetWizData();
    StringBase name = wanted;
    for (int i = 1; i <= 99 && data; ++i) {
        const Tsy_Block* holder = data->GetNamedBlock(name);
        if (!holder || holder == block)
            break;
        name = StringBase::Printf("%s%d", wanted.c_str(), i);
    }
    return name;
}

// A legal name loses the blanks around it; an illegal one is refused.
bool Tsy_DCMgenSetup::checkInstanceNameIsLegal(Tsy_Block* block)
{
    StringBase name = block->GetName();
    name.Trim();
    if (name.IsEmpty()) {
        IssueMessage("Block has no name specified", true, false, false);
        return false;
    }
    if (UT_STR::IsDigit(name[0])) {
        IssueMessage("The DCM Instance Name cannot begin with a number.  Please specify a valid instance name before "
                     "continuing.",
                     true, false, false);
        return false;
    }
    if (!isLettersDigitsAndUnderscores(name)) {
        IssueMessage("Invalid DCM Instance Name specified.  Please check this before continuing.", true, false, false);
        return false;
    }
    // Letters, digits and '_' are not enough for both HDLs: keywords and
    // doubled or trailing '_' break one of them.
    if (std::string why = Tsy_HdlNameProblem(name.str()); !why.empty()) {
        IssueMessage(StringBase::Printf("The DCM Instance Name '%s' %s.  Please specify a valid instance name "
                                        "before continuing.",
                                        name.c_str(), why.c_str()),
                     true, false, false);
        return false;
    }
    if (name != block->GetName())
        block->SetName(name);
    return true;
}

void Tsy_DCMgenSetup::warnIfModuleNamedAfterPrimitive()
{
    Tsy_DCMwiz* wiz = GetDCMWiz();
    if (wiz && wiz->GetModuleName().EqualsNoCase(wiz->GetDCMPrimName()))
        IssueMessage(StringBase::Printf("The module name '%s' is the same as a library primitive name of an instance in "
                                        "this module.  This may cause errors during synthesis.",
                                        wiz->GetModuleName().c_str()),
                     false, false, false);
}

// Values that reach the primitive must be ones it knows; only a design file
// or a batch setting can bring in others.
bool Tsy_DCMgenSetup::checkListValues()
{
    struct Check {
        int list;
        const char* attribute;
        StringBase value;
    } checks[] = {
        {ListClkdvDivide, Tsy_Attr::CLKDV_DIVIDE, s_.clkdvDivide},
        {ListPhaseShift, Tsy_Attr::CLKOUT_PHASE_SHIFT,
         s_.psType == PsUnknown ? s_.psTypeText : StringBase(PsTypeName(s_.psType))},
        {ListDeskewAdjust, Tsy_Attr::DESKEW_ADJUST, s_.deskewAdjust},
    };
    for (const auto& c : checks) {
        const Tsy_StrArray& allowed = GetDcmValueList(c.list);
        if (allowed.IsEmpty())
            continue;
        bool found = false;
        for (const auto& v : allowed.Items())
            found = found || v.EqualsNoCase(c.value);
        if (!found) {
            StringBase prim = GetDCMWiz() ? GetDCMWiz()->GetDCMPrimName() : StringBase();
            IssueMessage(StringBase::Printf("'%s' is not a valid value of %s for the %s primitive.  Please choose one "
                                            "of the listed values.",
                                            c.value.c_str(), c.attribute, prim.c_str()),
                         true, false, false);
            return false;
        }
    }
    return true;
}

bool Tsy_DCMgenSetup::checkFrequencyModes()
{
    const int outputs = GetOutputType();
    if (wizType_ == Tsy_DCMwiz::TypeCascading && (SelectedWithoutValidRange() || SelectedInHighFrequencyMode())) {
        int reportCase = CaseCascadeFirst;
        if (GetInstNum() == 2) {
            const Tsy_Block* first = GetActiveDCMBlk(1, false);
            bool clkdv = first && first->GetAttributeValue(Tsy_Attr::TESY_ONLY_CASCADING_CLK).EqualsNoCase("CLKDV");
            reportCase = clkdv ? CaseCascadeSecondClkdv : CaseCascadeSecond;
        }
        ReportFrequencyRanges(reportCase);
        return false;
    }
    if (gen45_ && s_.perfMode == PerfMaxRange && SelectedInHighFrequencyMode()) {
        ReportFrequencyRanges(CaseMaxRange);
        return false;
    }
    const bool dllBad = isDll(outputs) && dllMode_ == 0;
    const bool dfsBad = isDfs(outputs) && dfsMode_ == 0;
    if (dllBad || dfsBad) {
        ReportFrequencyRanges(dllBad && dfsBad ? CaseDllAndDfs : dllBad ? CaseDll : CaseDfs);
        return false;
    }
    if (!gen45_ && s_.fbSource == FbSourceInternal && s_.fbValue == FbValue2X && SelectedInHighFrequencyMode()) {
        IssueMessage("CLK2X is not valid in High Frequency Mode.  Please select feedback value 1X or change the Input "
                     "Clock Frequency to be within Low Frequency Mode.",
                     true, false, false);
        return false;
    }
    return true;
}

bool Tsy_DCMgenSetup::checkFeedback()
{
    const int outputs = GetOutputType();
    const char* base = nullptr;
    if (isDll(outputs) && s_.fbSource == FbSourceNone)
        base = "When any DLL outputs (CLK0, CLK90, CLK180, CLK270, CLKDV, CLK2X, CLK2X180) are used, the feedback "
               "source cannot be None.";
    else if (outputs == OutputDfs && s_.fbSource != FbSourceNone)
        base = "When only DFS outputs (CLKFX, CLKFX180) are used, the feedback source must be set to None.";
    if (base) {
        const bool userChoosesFeedback =
            wizType_ == Tsy_DCMwiz::TypeDcm || wizType_ == Tsy_DCMwiz::TypeClockForwarding;
        if (userChoosesFeedback)
            IssueMessage(StringBase::Printf("%s  Please adjust your selected output clocks or your Feedback Source "
                                            "setting to correct this.",
                                            base),
                         true, false, false);
        else
            IssueMessage(StringBase::Printf("%s  Please adjust your selected output clocks to correct this.", base),
                         true, false, false);
        return false;
    }
    if (!gen45_ && s_.fbSource == FbSourceExternal && !s_.resetLogic)
        IssueMessage("Resetting after configuration is strongly recommended for a DCM that is configured with external "
                     "feedback.  Refer to Corvane Answer Record 14425 for an example of reset logic.",
                     false, false, false);
    return true;
}

bool Tsy_DCMgenSetup::checkOutputRange(bool clkdv)
{
    const char* mode = dllMode_ == 2 ? "HF" : "LF";
    float min = speed(clkdv ? "CLKOUT_FREQ_DV_%s_Min" : "CLKOUT_FREQ_2X_%s_Min", mode);
    float max = speed(clkdv ? "CLKOUT_FREQ_DV_%s_Max" : "CLKOUT_FREQ_2X_%s_Max", mode);
    float f;
    if (clkdv) {
        double divide = 0.0;
        // A divider that is not a positive number leaves CLKDV without a
        // frequency, which no range holds.
        f = UT_STR::ParseDouble(s_.clkdvDivide, divide) && divide > 0.0
                ? static_cast<float>(static_cast<double>(inputFreq_) / divide)
                : 0.0f;
    } else {
        f = inputFreq_ * 2.0f;
    }
    if (f > 0.0f && min <= f && f <= max)
        return true;

    const char* modeName = dllMode_ == 2 ? "High Frequency" : "Low Frequency";
    double a = min, b = max;
    const char* unit = "MHz";
    if (s_.units == UnitsNs) {
        a = Tsy_SpeedData::FreqToPeriod(min);
        b = Tsy_SpeedData::FreqToPeriod(max);
        unit = "ns";
    }
    if (clkdv)
        IssueMessage(StringBase::Printf("The specified Input Clock Frequency has been determined to fall within the %s "
                                        "mode.  The valid range for CLKDV is %3.3f - %3.3f %s, but with the current "
                                        "Divide setting, CLKDV is out of the valid range.  Please adjust your 'Input "
                                        "Clock Frequency' and the setting for 'Divide By Value' to fix this.",
                                        modeName, a, b, unit),
                     true, false, false);
    else
        IssueMessage(StringBase::Printf("The specified Input Clock Frequency has been determined to fall within the %s "
                                        "mode.  The valid range for CLK2X and CLK2X180 is %3.3f - %3.3f %s.  Please "
                                        "change your 'Input Clock Frequency' so that when doubled, it will be within "
                                        "this range.",
                                        modeName, a, b, unit),
                     true, false, false);
    return false;
}

bool Tsy_DCMgenSetup::checkPhaseShift()
{
    ComputePhaseShiftLimits();
    ComputePhaseShiftDisplay();
    int value = 0;
    const bool whole = UT_STR::ParseInt(s_.psValue, value);

    if (whole && s_.psType == PsFixed && psLowest_ <= value && value < 0) {
        // A batch run cannot stop to ask; the user asked for the value, so it
        // is kept and the workaround is pointed out.
        if (Tsy_Family::IsTaldor2Pro(family_)) {
            if (!ask("A fixed phase shift with negative phase shift value is specified. Certain Taldor-II Pro devices "
                     "require a workaround for this DCM configuration. Please reference Answer Record 13349 for "
                     "details.  The Pendra cannot support the work around so the workaround must be added manually. "
                     "Do you want to continue with the negative value and make changes manually if required? (If "
                     "not, please update the phase shift value to a positive number).",
                     1))
                return false;
        } else if (Tsy_Family::IsTaldor2(family_)) {
            if (!ask("A fixed phase shift with negative phase shift value is specified. A workaround is required for "
                     "this DCM configuration. Please reference Answer Record 13349 for details. The Pendra cannot "
                     "support the work around.  Do you want to continue with the negative value and make changes "
                     "yourself as described in the solution record? (If not, please update the phase shift value to "
                     "a positive number.)",
                     1))
                return false;
        }
    }
    if (psDegrees_ >= 360.0) {
        IssueMessage("Amount of phase shift should not exceed CLKIN period. Please enter a valid phase shift value.",
                     true, false, false);
        return false;
    }
    // The form's value box keeps the value within the limits; a design file
    // or a batch setting is held to them here.
    if (!whole || value < psLowest_ || value > psHighest_) {
        IssueMessage(StringBase::Printf("The phase shift value '%s' is outside the valid range of %d to %d.  Please "
                                        "enter a valid phase shift value.",
                                        s_.psValue.c_str(), psLowest_, psHighest_),
                     true, false, false);
        return false;
    }
    if (s_.psType == PsDirect && value != 0)
        IssueMessage("When the DIRECT phase shift type is used, the starting phase shift value is always 0, regardless "
                     "of the number specified in the Phase Shift 'Value' field.  The non-zero value for DIRECT mode can "
                     "only be loaded to the DCM when a specific 'load phase shift value' command is given by Dynamic "
                     "Reconfiguration.  Refer to the 'Dynamic Reconfiguration' section of the HW user guide fore more "
                     "information.",
                     false, false, false);
    return true;
}

bool Tsy_DCMgenSetup::checkStartupWait()
{
    if (GetInstNum() != 2)
        return true;
    const Tsy_Block* first = GetActiveDCMBlk(1, false);
    if (first) {
        StringBase firstWait = first->GetAttributeValue(Tsy_Attr::STARTUP_WAIT);
        bool differ = (firstWait.EqualsNoCase("TRUE") && !s_.startupWait) ||
                      (firstWait.EqualsNoCase("FALSE") && s_.startupWait);
        // Differing values are a recommendation, not a fault: a batch run
        // notes it and goes on.
        if (differ && ask(StringBase::Printf("STARTUP_WAIT is set to %s for DCM INST1 and is set to %s for DCM INST2.  "
                                             "Both DCMs should have the same STARTUP_WAIT value.  Would you like to go "
                                             "BACK to set both DCM instances with the same value?",
                                             firstWait.c_str(), s_.startupWait ? "TRUE" : "FALSE"),
                          0))
            return false;
    }
    if (!s_.startupWait && !s_.pins[PinLOCKED])
        IssueMessage("LOCKED is not selected. It is essential to monitor LOCKED signal at all times to ensure that "
                     "system flip-flops not be enabled until after the DCM that drives their clock input has locked.  "
                     "To ensure that DCM is properly locked at startup, either the LOCKED signal must be monitored or "
                     "the STARTUP_WAIT option must be used (setting available in Advanced dialog).",
                     false, false, false);
    return true;
}

void Tsy_DCMgenSetup::stepNote()
{
    Tsy_DCMwiz* wiz = GetDCMWiz();
    if (!wiz || !Tsy_Family::Is(family_, "membra3e") || !isDfs(GetOutputType()))
        return;
    if (!wiz->HasDeviceTrait("narrow_first_stepping"))
        return;
    if (inputFreq_ < kStepping0Min || inputFreq_ > kStepping0Max)
        IssueMessage(StringBase::Printf("The Input Clock Frequency correctly falls within the Membra3E Stepping 1 valid "
                                        "range.  However, the Input Clock Frequency does not fall within the valid "
                                        "Membra3E Stepping 0 range of %d - %d.  Please check the Datasheet.\n",
                                        kStepping0Min, kStepping0Max),
                     false, false, false);
}
