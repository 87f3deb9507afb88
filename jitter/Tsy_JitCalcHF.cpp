#include "jitter/Tsy_JitCalcHF.h"

bool Tsy_JitCalcHF::CalculateJitter(Tsy_SpeedData* /*speed*/, float fin, float fout, int m, int d, float& r1,
                                    float& r2, float& r3, float& r4) const
{
    // K = max(M, D), widened so that no M or D, however large, overflows;
    // the products are exact in double, as they were in int.
    const double bigK = m > d ? m : d;
    float j = 0.0f;
    switch (GetFamilyGroup()) {
    case GroupTaldor2Pro:
        j = bigK * 4 * 0.03125 + 0.06 * fout;
        break;
    case GroupGeneration45:
        j = 0.07 * fout - 4.8;
        break;
    case GroupOther: {
        // The base term was fitted in three input bands; outside them only
        // the divider term is known.
        float b = 0.0f;
        if (fin >= 50 && fin <= 100)
            b = (fout - 210) * 7 / 110 + (0.04 * fin + 10);
        else if (fin > 100 && fin <= 200)
            b = (fout - 210) * 7 / 110 + 14;
        else if (fin > 200 && fin <= 400)
            b = (fout - 210) * 7 / 110 + (0.02 * fin + 10);
        j = bigK * 4 * 0.03125 + b;
        break;
    }
    }
    ToFigures(j, fin, fout, d, r1, r2, r3, r4);
    return true;
}
