#include "wizard/Tsy_SpeedData.h"

#include "lib/Dly_SpeedController.h"
#include "lib/PM_PIC.h"
#include "port/Exception.h"
#include "port/SharedResourceMgr.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wiz/Tsy_WizPage.h"

#include <cfloat>
#include <limits>
#include <string>

namespace {

using ControllerRegistry = Util::Details::SharedRegistry<const PM_PIC*, Dly_SpeedController>;

// Users of the same personality share one controller.
ControllerRegistry& controllers()
{
    return Util::Details::SharedRegistryFor<const PM_PIC*, Dly_SpeedController>(std::string("Dly_SpeedController") +
                                                                                "PM_PIC*");
}

const char* const kGenericKeys[] = {
    "CLKOUT_FREQ_1X_LF_Min", "CLKOUT_FREQ_1X_LF_Max", "CLKOUT_FREQ_2X_LF_Min", "CLKOUT_FREQ_2X_LF_Max",
    "CLKOUT_FREQ_DV_LF_Min", "CLKOUT_FREQ_DV_LF_Max", "CLKOUT_FREQ_FX_LF_Min", "CLKOUT_FREQ_FX_LF_Max",
    "CLKIN_FREQ_DLL_LF_Min", "CLKIN_FREQ_DLL_LF_Max", "CLKIN_FREQ_FX_LF_Min",  "CLKIN_FREQ_FX_LF_Max",
    "PSCLK_FREQ_LF_Min",     "PSCLK_FREQ_LF_Max",     "CLKOUT_FREQ_1X_HF_Min", "CLKOUT_FREQ_1X_HF_Max",
    "CLKOUT_FREQ_2X_HF_Min", "CLKOUT_FREQ_2X_HF_Max", "CLKOUT_FREQ_DV_HF_Min", "CLKOUT_FREQ_DV_HF_Max",
    "CLKOUT_FREQ_FX_HF_Min", "CLKOUT_FREQ_FX_HF_Max", "CLKIN_FREQ_DLL_HF_Min", "CLKIN_FREQ_DLL_HF_Max",
    "CLKIN_FRQ_FX_HF_Min",   "CLKIN_FRQ_FX_HF_Max",   "PSCLK_FREQ_HF_Min",     "PSCLK_FREQ_HF_Max",
};

const char* const kMembra3eCappedKeys[] = {"CLKOUT_FREQ_FX_LF_Max", "CLKOUT_FREQ_FX_HF_Max", "CLKOUT_FRQ_FX_LF_Max",
                                           "CLKOUT_FRQ_FX_HF_Max"};

// "CLKIN_FREQ_DLL_LF_Min" -> "CLKIN_FREQ_DLL_LF_MS_Min"; the synthesizer's
// high-frequency input keys are spelled FRQ generically but FREQ per mode.
StringBase withModeInfix(const StringBase& generic, const char* infix)
{
    StringBase base = generic.Left(generic.GetLength() - 3);
    StringBase tail = generic.Mid(generic.GetLength() - 3);
    if (base.StartsWith("CLKIN_FRQ_FX_HF_"))
        base = StringBase("CLKIN_FREQ_FX_HF_");
    return base + infix + tail;
}

} // namespace

Tsy_SpeedData::Tsy_SpeedData() = default;

Tsy_SpeedData::~Tsy_SpeedData()
{
    releaseController();
    delete pic_;
}

void Tsy_SpeedData::releaseController()
{
    if (controller_ && pic_)
        controllers().Release(pic_);
    controller_ = nullptr;
}

bool Tsy_SpeedData::Load(const StringBase& partName)
{
    releaseController();
    delete pic_;
    pic_ = new PM_PIC(partName.str(), 1, 0);
    if (!pic_->IsValid())
        return false;
    pic_->fill_defaults();
    try {
        controller_ = controllers().Get(pic_);
        if (!controller_)
            controller_ = controllers().Create(pic_, std::make_unique<Dly_SpeedController>(pic_));
    } catch (const Port::Exception&) {
        controller_ = nullptr;
        return false;
    }
    membra3e_ = wizard_ && wizard_->GetFamilyName().Compare("membra3e", Port::CompareNoCase) == 0;
    return true;
}

// Keys outside the generic list pass unchanged; among them
// "FINE_SHIFT_RANGE_MS" and "FINE_SHIFT_RANGE_MR", which carry their mode in
// their own names.
StringBase Tsy_SpeedData::TranslateKey(const StringBase& key)
{
    if (!wizard_ || !wizard_->IsPerformanceModeKeys())
        return key;
    if (perfMode_ != MaxSpeed && perfMode_ != MaxRange)
        perfMode_ = MaxSpeed;
    for (const char* generic : kGenericKeys) {
        if (key.Compare(generic, Port::CompareNoCase) != 0)
            continue;
        StringBase g(generic);
        if (perfMode_ == MaxRange && (g == "CLKOUT_FREQ_2X_HF_Min" || g == "CLKOUT_FREQ_2X_HF_Max"))
            return key;
        return withModeInfix(g, perfMode_ == MaxRange ? "MR_" : "MS_");
    }
    return key;
}

float Tsy_SpeedData::GetSpeedValue(const StringBase& key)
{
    StringBase translated = TranslateKey(key);
    if (!wizard_ || !controller_)
        return 0.0f;
    double v = controller_->GetBelDelay(translated.str(), nullptr);
    if (v == DBL_MAX) {
        StringBase text;
        text.Format("Unable to get data for %s from the speedsfile; the data on this dialog will not be accurate!!",
                    translated.c_str());
        Tsy_WizPage::DoMessage(text, quiet_, wizard_->GetStream(), true, wizard_->GetMessageFlag(), false);
        return 0.0f;
    }
    if (membra3e_)
        for (const char* capped : kMembra3eCappedKeys)
            if (translated.Compare(capped, Port::CompareNoCase) == 0)
                return 311.0f;
    return static_cast<float>(v * 1000000000.0);
}

float Tsy_SpeedData::GetFactor(const StringBase& key)
{
    if (!wizard_ || !controller_)
        return 0.0f;
    double v = controller_->GetFactor(key.str());
    if (v == DBL_MAX) {
        StringBase text;
        text.Format("Unable to get data for %s from the speedsfile; the data on this dialog will not be accurate!!",
                    key.c_str());
        Tsy_WizPage::DoMessage(text, quiet_, wizard_->GetStream(), true, wizard_->GetMessageFlag(), false);
        return std::numeric_limits<float>::infinity();
    }
    return static_cast<float>(v);
}

float Tsy_SpeedData::FreqToPeriod(float mhz)
{
    return mhz == 0.0f ? 0.0f : 1000.0f / mhz;
}

float Tsy_SpeedData::PeriodToFreq(float ns)
{
    return ns == 0.0f ? 0.0f : 1000.0f / ns;
}

float Tsy_SpeedData::Multiply10000(float v)
{
    return v == 0.0f ? 0.0f : v * 10000.0f;
}

float Tsy_SpeedData::Divide10000(float v)
{
    return v == 0.0f ? 0.0f : v / 10000.0f;
}

bool Tsy_SpeedData::ReduceRatio(int a, int b, int& aOut, int& bOut)
{
    aOut = a;
    bOut = b;
    // A ratio of non-positive numbers has no reduction; searching one would
    // divide by zero.
    if (a <= 0 || b <= 0)
        return true;
    if (a == b) {
        aOut = bOut = 1;
        return true;
    }
    int smaller = a < b ? a : b;
    int larger = a < b ? b : a;
    int divisor = 1;
    for (int k = 1; k <= smaller; ++k) {
        if (smaller % k != 0)
            continue;
        int q = smaller / k;
        if (q == 1 || larger % q == 0) {
            divisor = q;
            break;
        }
    }
    aOut = a / divisor;
    bOut = b / divisor;
    return true;
}

int Tsy_SpeedData::CheckMultiplyDivide(float m, float d)
{
    if (m < 2.0f || m > 32.0f)
        return 0;
    if (d < 1.0f || d > 32.0f)
        return 1;
    return 2;
}
