#pragma once
// Jitter of the synthesizer running in its high-frequency mode.

#include "jitter/Tsy_JitCalc.h"

class Tsy_JitCalcHF : public Tsy_JitCalc {
public:
    using Tsy_JitCalc::Tsy_JitCalc;
    bool CalculateJitter(Tsy_SpeedData* speed, float fin, float fout, int m, int d, float& r1, float& r2, float& r3,
                         float& r4) const override;
};
