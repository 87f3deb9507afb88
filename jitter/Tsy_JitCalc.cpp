#include "jitter/Tsy_JitCalc.h"

#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_Family.h"

#include <cmath>

Tsy_JitCalc::Tsy_JitCalc(Tsy_DCMwiz* wizard) : wizard_(wizard) {}

Tsy_JitCalc::~Tsy_JitCalc() = default;

Tsy_JitCalc::FamilyGroup Tsy_JitCalc::GetFamilyGroup() const
{
    StringBase family = wizard_ ? wizard_->GetFamilyName() : StringBase("taldor2");
    if (Tsy_Family::IsTaldor2Pro(family))
        return GroupTaldor2Pro;
    if (Tsy_Family::IsGeneration45(family))
        return GroupGeneration45;
    return GroupOther;
}

bool Tsy_JitCalc::IsNoiseFreeModel() const
{
    return wizard_ && wizard_->IsBufgctrlFamily();
}

void Tsy_JitCalc::ToFigures(float j, float fin, float fout, int d, float& r1, float& r2, float& r3, float& r4) const
{
    // A zero output has no period; its figures are zero rather than infinite.
    float t = fout != 0.0f ? 1000 / fout : 0.0f;
    if (!IsNoiseFreeModel()) {
        r1 = j / 100;
        r2 = fout != 0.0f ? r1 * t : 0.0f;
        return;
    }
    r1 = t;
    r2 = t * j / 100;
    // The noise-free fit runs from A at D = 1 linearly to Bn at D = 32.
    float a = 0.8891 - 0.0145 * fin;
    if (a < 0.2)
        a = 0.2;
    float bn = fin > 0.0f ? 6.0969 * std::pow(fin, -0.6074) : 0.0f;
    float s = (bn - a) / 31;
    float v = s * d + (a - s);
    r4 = v;
    r3 = t != 0.0f ? v / t : 0.0f;
}
