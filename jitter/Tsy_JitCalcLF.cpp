#include "jitter/Tsy_JitCalcLF.h"

bool Tsy_JitCalcLF::CalculateJitter(Tsy_SpeedData* /*speed*/, float fin, float fout, int m, int d, float& r1,
                                    float& r2, float& r3, float& r4) const
{
    // K = max(M, D), widened so that no M or D, however large, overflows;
    // the products are exact in double, as they were in int.
    const double bigK = m > d ? m : d;
    float j = 0.0f;
    switch (GetFamilyGroup()) {
    case GroupTaldor2Pro: {
        int k = fin <= 8 ? 4 : 5;
        j = bigK * k * 0.03125 + 0.06 * fout;
        break;
    }
    case GroupGeneration45:
        j = fin < 48 ? 0.067 * fout + 1.5 : 0.045 * fout + 0.5;
        break;
    case GroupOther: {
        // The input-dependent term vanishes outside the characterised inputs.
        int k = 0;
        if (fin >= 1 && fin < 4)
            k = 2;
        else if (fin >= 4 && fin < 8)
            k = 3;
        else if (fin >= 8 && fin <= 100)
            k = 4;
        j = bigK * k * 0.03125 + ((fout - 24) * 14 / 216 + 2);
        break;
    }
    }
    ToFigures(j, fin, fout, d, r1, r2, r3, r4);
    return true;
}
