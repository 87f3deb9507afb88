// The synthesizer's jitter figures: every family group and frequency mode of
// the fits, both jitter models, and the generation-4/5 model with its
// performance modes. Expected jitters are worked out by hand (the arithmetic
// is beside each case); the calculators run in single precision, so figures
// are compared to a few parts in a million.

#include "jitter/Tsy_JitCalcHF.h"
#include "jitter/Tsy_JitCalcLF.h"
#include "pages/dcm/Tsy_JitterDlg.h"
#include "support/TestDesign.h"

#include <gtest/gtest.h>

#include <cmath>
#include <memory>

namespace {

void expectClose(double actual, double expected, const std::string& what)
{
    EXPECT_NEAR(actual, expected, 2e-6 * std::max(1.0, std::fabs(expected))) << what;
}

struct Figures {
    float r1 = -1.0f, r2 = -1.0f, r3 = -1.0f, r4 = -1.0f;
};

Figures run(const Tsy_JitCalc& calc, float fin, float fout, int m, int d)
{
    Figures f;
    EXPECT_TRUE(calc.CalculateJitter(nullptr, fin, fout, m, d, f.r1, f.r2, f.r3, f.r4));
    return f;
}

std::unique_ptr<Tsy_JitCalc> calculator(bool high, Tsy_DCMwiz* wizard)
{
    if (high)
        return std::make_unique<Tsy_JitCalcHF>(wizard);
    return std::make_unique<Tsy_JitCalcLF>(wizard);
}

} // namespace

TEST(JitterCalculators, StandardModelForEveryFamilyGroupAndMode)
{
    struct Case {
        const char* part; // selects the family group
        bool high;
        float fin, fout;
        int m, d;
        double percent; // J
        const char* how;
    } cases[] = {
        // Taldor-II Pro, low: k = 4 up to 8 MHz in, else 5; J = K k / 32 + 0.06 fout.
        {"t2p7-5", false, 8.0f, 100.0f, 5, 3, 6.625, "5*4/32 + 6"},
        {"t2p7-5", false, 8.5f, 50.0f, 2, 7, 4.09375, "7*5/32 + 3"},
        // Generation 4/5, low: the fit changes at 48 MHz in.
        {"t5da1-1", false, 47.9f, 100.0f, 3, 1, 8.2, "0.067*100 + 1.5"},
        {"t5da1-1", false, 48.0f, 100.0f, 3, 1, 5.0, "0.045*100 + 0.5"},
        {"t4a25-10", false, 20.0f, 200.0f, 10, 1, 14.9, "0.067*200 + 1.5"},
        // Other families, low: k = 2 on [1, 4), 3 on [4, 8), 4 on [8, 100], else 0.
        {"t2a250-4", false, 1.0f, 24.0f, 3, 1, 2.1875, "3*2/32 + 0*14/216 + 2"},
        {"t2a250-4", false, 3.99f, 24.0f, 3, 1, 2.1875, "3*2/32 + 2"},
        {"t2a250-4", false, 4.0f, 240.0f, 6, 1, 16.5625, "6*3/32 + 216*14/216 + 2"},
        {"t2a250-4", false, 7.99f, 240.0f, 6, 1, 16.5625, "6*3/32 + 16"},
        {"t2a250-4", false, 10.0f, 60.0f, 6, 1, 5.0833333, "6*4/32 + 36*14/216 + 2"},
        {"m3s200-4", false, 100.0f, 132.0f, 4, 3, 9.5, "4*4/32 + 7 + 2"},
        {"m3e100-4", false, 0.5f, 60.0f, 30, 1, 4.3333333, "k = 0 below 1 MHz"},
        {"t2a250-4", false, 150.0f, 60.0f, 2, 5, 4.3333333, "k = 0 above 100 MHz"},
        {"t2a250-4", false, 10.0f, 0.0f, 2, 1, 0.6944444, "2*4/32 - 24*14/216 + 2"},
        // High: Taldor-II Pro K*4/32 + 0.06 fout; generation 4/5 0.07 fout - 4.8.
        {"t2p7-5", true, 100.0f, 300.0f, 10, 3, 19.25, "10*4/32 + 18"},
        {"t5da1-1", true, 100.0f, 300.0f, 3, 1, 16.2, "21 - 4.8"},
        // Other families, high: K*4/32 + B, B fitted in three input bands.
        {"t2a250-4", true, 50.0f, 320.0f, 8, 5, 20.0, "8/8 + 110*7/110 + 2 + 10"},
        {"t2a250-4", true, 100.0f, 210.0f, 2, 1, 14.25, "2/8 + 0 + 4 + 10"},
        {"t2a250-4", true, 100.5f, 430.0f, 3, 1, 28.375, "3/8 + 14 + 14"},
        {"t2a250-4", true, 200.0f, 210.0f, 2, 1, 14.25, "2/8 + 14"},
        {"t2a250-4", true, 250.0f, 265.0f, 4, 1, 19.0, "4/8 + 3.5 + 5 + 10"},
        {"t2a250-4", true, 400.0f, 210.0f, 2, 1, 18.25, "2/8 + 8 + 10"},
        {"t2a250-4", true, 40.0f, 300.0f, 6, 2, 0.75, "B = 0 below 50 MHz"},
        {"t2a250-4", true, 401.0f, 300.0f, 2, 16, 2.0, "B = 0 above 400 MHz"},
    };
    for (const auto& c : cases) {
        TestDesign d("dcm", c.part);
        d.Configure([](Tsy_WizContext& ctx) { ctx.bufgctrlFamily = false; });
        Figures f = run(*calculator(c.high, &d.Wizard()), c.fin, c.fout, c.m, c.d);
        std::string what = std::string(c.part) + (c.high ? " high " : " low ") + c.how;
        expectClose(f.r1, c.percent / 100.0, what + " (unit interval)");
        expectClose(f.r2, c.fout > 0 ? c.percent / 100.0 * 1000.0 / c.fout : 0.0, what + " (pk-to-pk ns)");
        EXPECT_EQ(f.r3, -1.0f) << what << ": the standard model leaves r3 and r4 alone";
        EXPECT_EQ(f.r4, -1.0f) << what;
    }
    // The worked example, to the figures published with it.
    Figures f = run(Tsy_JitCalcLF(nullptr), 10.0f, 60.0f, 6, 1);
    EXPECT_NEAR(f.r1, 0.0508, 5e-5);
    EXPECT_NEAR(f.r2, 0.847, 5e-4);
}

TEST(JitterCalculators, NoiseFreeModelRunsFromAToBnAcrossD)
{
    TestDesign design("dcm", "t2a250-4");
    design.Configure([](Tsy_WizContext& ctx) { ctx.bufgctrlFamily = true; });
    Tsy_JitCalcLF lf(&design.Wizard());
    Tsy_JitCalcHF hf(&design.Wizard());
    ASSERT_TRUE(lf.IsNoiseFreeModel());
    // A = 0.8891 - 0.0145 fin, at least 0.2; Bn = 6.0969 fin^-0.6074.
    const std::pair<float, double> ends[] = {{70.0f, 0.2}, {20.0f, 0.5991}, {8.0f, 0.7731}};
    for (auto [fin, a] : ends) {
        const double bn = 6.0969 * std::pow(static_cast<double>(fin), -0.6074);
        for (int d : {1, 11, 32}) {
            std::string what = "fin " + std::to_string(fin) + " D " + std::to_string(d);
            double v = a + (d - 1) * (bn - a) / 31.0;
            for (const Tsy_JitCalc* calc : {static_cast<Tsy_JitCalc*>(&lf), static_cast<Tsy_JitCalc*>(&hf)}) {
                Figures f = run(*calc, fin, 100.0f, 4, d);
                expectClose(f.r4, v, what + " pk-to-pk");
                expectClose(f.r3, v / 10.0, what + " unit interval");
                expectClose(f.r1, 10.0, what + ": r1 holds the period");
            }
        }
        // r2 stays the standard peak-to-peak figure of the same J.
        expectClose(run(lf, fin, 100.0f, 4, 1).r2, run(Tsy_JitCalcLF(nullptr), fin, 100.0f, 4, 1).r2, "r2");
    }
}

TEST(JitterCalculators, NoInputDividesByZeroOrOverflows)
{
    TestDesign design("dcm", "t2a250-4");
    design.Configure([](Tsy_WizContext& ctx) { ctx.bufgctrlFamily = true; });
    const std::pair<float, float> inputs[] = {{0.0f, 0.0f}, {0.0f, 100.0f}, {-5.0f, 100.0f}, {1e30f, 1e30f}};
    for (bool high : {false, true})
        for (auto [fin, fout] : inputs) {
            Figures f = run(*calculator(high, &design.Wizard()), fin, fout, 2147483647, -2147483647);
            EXPECT_TRUE(std::isfinite(f.r1) && std::isfinite(f.r2) && std::isfinite(f.r3) && std::isfinite(f.r4))
                << fin << " -> " << fout;
        }
    float ns = -1.0f, ui = -1.0f;
    Tsy_JitterDlg::Gen45Jitter("taldor5", 0.0f, 200.0f, 1.0f, false, "MAX_SPEED", ns, ui);
    EXPECT_EQ(ns, 0.0f);
    Tsy_JitterDlg::Gen45Jitter("taldor4", 100.0f, 0.0f, 4.0f, false, "MAX_SPEED", ns, ui);
    EXPECT_GT(ns, 0.0f);
    EXPECT_EQ(ui, 0.0f);
}

TEST(Generation45Model, EndPointsByFamilyModeAndPerformanceMode)
{
    const double fout = 300.0;
    auto p = [](double x, double e) { return std::pow(x, e); };
    struct Case {
        const char* family;
        bool high;
        const char* perf;
        double fin;
        double a, bn; // ps on taldor5, ns on the taldor4 group
        bool ps;
    } cases[] = {
        {"taldor5", true, "MAX_SPEED", 100, 156 - 10, 6832 * p(100, -0.5422), true},
        {"taldor5", true, "MAX_RANGE", 400, 156 - 40, 6832 * p(400, -0.5422), true},
        {"taldor5", false, "MAX_RANGE", 30, 232.8 - 21, 25423 * p(30, -0.7674), true},
        {"taldor5", false, "MAX_SPEED", 100, 1114 * p(100, -0.5057), 31157 * p(100, -0.8517), true},
        {"taldor5", false, "", 100, 1114 * p(100, -0.5057), 31157 * p(100, -0.8517), true},
        {"taldor4", false, "MAX_RANGE", 20, 0.5991, 6.0969 * p(20, -0.6074), false},
        {"qtaldor4", true, "MAX_SPEED", 100, 0.2, 6.0969 * p(100, -0.6074), false},
        {"qrtaldor4", false, "MAX_SPEED", 100, 0.2, 6.0969 * p(100, -0.6074), false},
    };
    for (const auto& c : cases)
        for (float d : {1.0f, 8.0f, 32.0f}) {
            float ns = 0.0f, ui = 0.0f;
            Tsy_JitterDlg::Gen45Jitter(c.family, static_cast<float>(c.fin), static_cast<float>(fout), d, c.high,
                                       c.perf, ns, ui);
            double v = (c.a + (d - 1) * (c.bn - c.a) / 31.0) * (c.ps ? 0.001 : 1.0);
            std::string what = std::string(c.family) + (c.high ? " high " : " low ") + c.perf + " D " +
                               std::to_string(static_cast<int>(d));
            expectClose(ns, v, what + " pk-to-pk ns");
            expectClose(ui, v / (1000.0 / fout), what + " unit interval");
        }
}
