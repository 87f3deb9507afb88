// Speed data: loading once per wizard, key translation for the performance
// modes, the Membra-3E synthesizer maximum, missing keys, and the small
// arithmetic helpers the pages share.

#include "support/TestDesign.h"
#include "wizard/Tsy_SpeedData.h"
#include "wizard/Tsy_SpeedKeys.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

Tsy_SpeedData& speedOf(TestDesign& d)
{
    d.Instantiate();
    EXPECT_NE(d.Wizard().GetSpdDataPtr(), nullptr);
    return *d.Wizard().GetSpdDataPtr();
}

} // namespace

TEST(SpeedData, TranslatesGenericKeysPerPerformanceMode)
{
    TestDesign d("dcm", "t5da1-1");
    Tsy_SpeedData& s = speedOf(d);
    struct Case {
        int mode;
        const char* key;
        const char* expected;
    } cases[] = {
        {0, "CLKIN_FREQ_DLL_LF_Min", "CLKIN_FREQ_DLL_LF_MS_Min"},
        {1, "CLKIN_FREQ_DLL_LF_Min", "CLKIN_FREQ_DLL_LF_MR_Min"},
        {0, "clkin_freq_dll_hf_max", "CLKIN_FREQ_DLL_HF_MS_Max"},
        {0, "CLKIN_FRQ_FX_HF_Min", "CLKIN_FREQ_FX_HF_MS_Min"},
        {1, "CLKIN_FRQ_FX_HF_Max", "CLKIN_FREQ_FX_HF_MR_Max"},
        {0, "CLKOUT_FREQ_2X_HF_Min", "CLKOUT_FREQ_2X_HF_MS_Min"},
        {1, "CLKOUT_FREQ_2X_HF_Min", "CLKOUT_FREQ_2X_HF_Min"},
        {1, "CLKOUT_FREQ_2X_HF_Max", "CLKOUT_FREQ_2X_HF_Max"},
        {1, "PSCLK_FREQ_LF_Max", "PSCLK_FREQ_LF_MR_Max"},
        {0, "FINE_SHIFT_RANGE_MS", "FINE_SHIFT_RANGE_MS"},
        {1, "FINE_SHIFT_RANGE_MR", "FINE_SHIFT_RANGE_MR"},
        {0, "CLKIN_FREQ_FX_HF_Min", "CLKIN_FREQ_FX_HF_Min"},
        {0, "O_MAX_HT_LT", "O_MAX_HT_LT"},
    };
    for (const auto& c : cases) {
        s.SetPerformanceMode(c.mode);
        EXPECT_EQ(s.TranslateKey(c.key), c.expected) << c.key << " in mode " << c.mode;
    }
    // A mode it does not know acts as maximum speed, and is put right.
    s.SetPerformanceMode(5);
    EXPECT_EQ(s.TranslateKey("CLKIN_FREQ_DLL_LF_Min"), "CLKIN_FREQ_DLL_LF_MS_Min");
    EXPECT_EQ(s.GetPerformanceMode(), 0);

    // Families without performance modes take the keys as they are.
    TestDesign older("dcm", "t2p7-5");
    Tsy_SpeedData& o = speedOf(older);
    o.SetPerformanceMode(1);
    EXPECT_EQ(o.TranslateKey("CLKIN_FREQ_DLL_LF_Min"), "CLKIN_FREQ_DLL_LF_Min");
    EXPECT_GT(o.GetSpeedValue("CLKIN_FREQ_DLL_LF_Min"), 0.0f);
    EXPECT_TRUE(older.Stream().Entries().empty());
}

TEST(SpeedData, FiguresReadAsMegahertz)
{
    TestDesign d("dcm", "t5da1-1");
    Tsy_SpeedData& s = speedOf(d);
    s.SetPerformanceMode(0);
    float lo = s.GetSpeedValue("CLKIN_FREQ_DLL_LF_Min");
    float hi = s.GetSpeedValue("CLKIN_FREQ_DLL_LF_Max");
    EXPECT_GT(lo, 1.0f);
    EXPECT_LT(lo, hi);
    EXPECT_LT(hi, 2000.0f);
    EXPECT_EQ(lo, std::round(lo * 1000.0f) / 1000.0f) << "no scaling residue";
}

TEST(SpeedData, MissingKeyIsReportedAndReadsAsZeroOrInfinity)
{
    TestDesign d("dcm", "t5da1-1");
    Tsy_SpeedData& s = speedOf(d);
    EXPECT_EQ(s.GetSpeedValue("NO_SUCH_KEY"), 0.0f);
    ASSERT_EQ(d.Stream().Entries().size(), 1u);
    EXPECT_EQ(d.Stream().Entries()[0].text,
              "Unable to get data for NO_SUCH_KEY from the speedsfile; the data on this dialog will not be "
              "accurate!!");
    EXPECT_TRUE(d.Stream().Entries()[0].isError);
    EXPECT_TRUE(std::isinf(s.GetFactor("PLL_MULT_99_BW_LOW_K1")));
    EXPECT_EQ(d.Stream().Entries().size(), 2u);
    EXPECT_GT(s.GetFactor("PLL_MULT_8_BW_LOW_K1"), 0.0f);
}

TEST(SpeedData, QuietFlagLogsInsteadOfShowing)
{
    TestDesign d("dcm", "t5da1-1", false);
    Tsy_SpeedData& s = speedOf(d);
    s.SetQuiet(true);
    s.GetSpeedValue("NO_SUCH_KEY");
    ASSERT_EQ(d.Stream().Entries().size(), 1u);
    EXPECT_TRUE(d.Stream().Entries()[0].logged);
}

TEST(SpeedData, Membra3eSynthesizerMaximumIs311WhenTheKeyExists)
{
    TestDesign d("dcm", "m3e100-4");
    Tsy_SpeedData& s = speedOf(d);
    EXPECT_TRUE(s.IsMembra3e());
    EXPECT_EQ(s.GetSpeedValue("CLKOUT_FREQ_FX_LF_Max"), 311.0f);
    EXPECT_EQ(s.GetSpeedValue("CLKOUT_FREQ_FX_HF_Max"), 311.0f);
    EXPECT_NE(s.GetSpeedValue("CLKOUT_FREQ_FX_LF_Min"), 311.0f);

    TestDesign other("dcm", "m3a200-4");
    EXPECT_FALSE(speedOf(other).IsMembra3e()) << "only the membra3e family itself";
}

TEST(SpeedData, LoadingTwiceKeepsTheFirstLoad)
{
    TestDesign d("dcm", "t5da1-1");
    Tsy_SpeedData& s = speedOf(d);
    EXPECT_TRUE(d.Wizard().IsSpdFileLoaded());
    EXPECT_FALSE(d.Wizard().LoadSpdFile(true));
    EXPECT_EQ(d.Wizard().GetSpdDataPtr(), &s);
}

TEST(SpeedData, UnknownPartReportsTheLoadFailure)
{
    TestDesign d("dcm", "t5da1-1");
    d.Configure([](Tsy_WizContext& c) { c.partName = "nosuchpart-9"; });
    d.Instantiate();
    EXPECT_EQ(d.Wizard().GetSpdDataPtr(), nullptr);
    EXPECT_FALSE(d.Wizard().IsSpdFileLoaded());
    ASSERT_EQ(d.Stream().Errors().size(), 1u);
    EXPECT_EQ(d.Stream().Errors()[0], "Error loading speedsfile for nosuchpart-9.");
}

TEST(SpeedData, ConversionsLeaveZeroAlone)
{
    EXPECT_FLOAT_EQ(Tsy_SpeedData::FreqToPeriod(100.0f), 10.0f);
    EXPECT_FLOAT_EQ(Tsy_SpeedData::PeriodToFreq(4.0f), 250.0f);
    EXPECT_EQ(Tsy_SpeedData::FreqToPeriod(0.0f), 0.0f);
    EXPECT_EQ(Tsy_SpeedData::PeriodToFreq(0.0f), 0.0f);
    EXPECT_FLOAT_EQ(Tsy_SpeedData::Multiply10000(0.1f), 1000.0f);
    EXPECT_FLOAT_EQ(Tsy_SpeedData::Divide10000(1000.0f), 0.1f);
    EXPECT_EQ(Tsy_SpeedData::Divide10000(0.0f), 0.0f);
}

TEST(SpeedData, RatioReduction)
{
    struct Case {
        int a, b, ea, eb;
    } cases[] = {
        {100, 50, 2, 1}, {50, 50, 1, 1}, {33, 100, 33, 100}, {25, 10, 5, 2}, {6, 4, 3, 2},
        {7, 13, 7, 13},  {64, 48, 4, 3}, {1, 9, 1, 9},       {0, 5, 0, 5},   {-4, 2, -4, 2},
    };
    for (const auto& c : cases) {
        int a = 0, b = 0;
        EXPECT_TRUE(Tsy_SpeedData::ReduceRatio(c.a, c.b, a, b));
        EXPECT_EQ(a, c.ea) << c.a << "/" << c.b;
        EXPECT_EQ(b, c.eb) << c.a << "/" << c.b;
    }
}

TEST(SpeedData, MultiplyDivideCheck)
{
    EXPECT_EQ(Tsy_SpeedData::CheckMultiplyDivide(1.0f, 1.0f), 0);
    EXPECT_EQ(Tsy_SpeedData::CheckMultiplyDivide(33.0f, 1.0f), 0);
    EXPECT_EQ(Tsy_SpeedData::CheckMultiplyDivide(2.0f, 0.0f), 1);
    EXPECT_EQ(Tsy_SpeedData::CheckMultiplyDivide(32.0f, 33.0f), 1);
    EXPECT_EQ(Tsy_SpeedData::CheckMultiplyDivide(2.0f, 1.0f), 2);
    EXPECT_EQ(Tsy_SpeedData::CheckMultiplyDivide(32.0f, 32.0f), 2);
}

namespace {

StringBase keyOf(const char* pattern, const char* fill)
{
    return StringBase::Printf(pattern, fill);
}

} // namespace

// Every key a page queries exists for every part where that page runs: a
// missing key would be reported to the user on every visit.
TEST(SpeedData, EveryPartHasEveryKeyItsPagesQuery)
{
    for (const Tsy_PartInfo& part : Tsy_DeviceCatalog::Instance().Parts()) {
        TestDesign d("dcm", part.part);
        Tsy_SpeedData& s = speedOf(d);
        const bool modes = d.Wizard().IsPerformanceModeKeys();
        std::vector<StringBase> keys;
        for (const char* infix : modes ? std::vector<const char*>{"MS_", "MR_"} : std::vector<const char*>{""}) {
            for (const char* p : {Tsy_SpeedKey::CLKIN_DLL_LF_MIN, Tsy_SpeedKey::CLKIN_DLL_LF_MAX,
                                  Tsy_SpeedKey::CLKIN_DLL_HF_MIN, Tsy_SpeedKey::CLKIN_DLL_HF_MAX,
                                  Tsy_SpeedKey::CLKIN_FX_LF_MIN, Tsy_SpeedKey::CLKIN_FX_LF_MAX})
                keys.push_back(keyOf(p, infix));
            keys.push_back(keyOf(modes ? Tsy_SpeedKey::CLKIN_FX_HF_MIN_MODES : Tsy_SpeedKey::CLKIN_FX_HF_MIN, infix));
            keys.push_back(keyOf(modes ? Tsy_SpeedKey::CLKIN_FX_HF_MAX_MODES : Tsy_SpeedKey::CLKIN_FX_HF_MAX, infix));
        }
        for (const char* band : {"LF", "HF"})
            for (const char* p : {Tsy_SpeedKey::CLKOUT_DV_MIN, Tsy_SpeedKey::CLKOUT_DV_MAX, Tsy_SpeedKey::CLKOUT_2X_MIN,
                                  Tsy_SpeedKey::CLKOUT_2X_MAX})
                keys.push_back(keyOf(p, band));
        for (const char* k : {Tsy_SpeedKey::CLKOUT_FX_LF_MIN, Tsy_SpeedKey::CLKOUT_FX_LF_MAX,
                              Tsy_SpeedKey::CLKOUT_FX_HF_MIN, Tsy_SpeedKey::CLKOUT_FX_HF_MAX, "CLKIN_FREQ_DLL_LF_Min",
                              "CLKIN_FREQ_DLL_HF_Max", "CLKIN_FRQ_FX_HF_Min", "CLKIN_FREQ_FX_LF_MS_Min",
                              "CLKIN_FREQ_FX_HF_MS_Min", "CLKIN_FREQ_DLL_LF_MS_Min", "CLKIN_FREQ_DLL_HF_MS_Min"})
            keys.push_back(k);
        for (int mode : modes ? std::vector<int>{0, 1} : std::vector<int>{0}) {
            s.SetPerformanceMode(mode);
            for (const auto& k : keys)
                s.GetSpeedValue(k);
        }
        if (part.family->Has("pll")) {
            for (const char* k : {Tsy_SpeedKey::PLL_CLKIN_MIN, Tsy_SpeedKey::PLL_CLKIN_MAX, Tsy_SpeedKey::PLL_VCO_MIN,
                                  Tsy_SpeedKey::PLL_VCO_MAX, Tsy_SpeedKey::PLL_O_MAX_HT_LT})
                EXPECT_GT(s.GetSpeedValue(k), 0.0f) << part.part << " " << k;
            for (int m = 1; m <= 64; ++m)
                for (const char* bw : {"LOW", "HIGH"})
                    for (int n : Tsy_SpeedKey::kPllJitterConstants)
                        s.GetFactor(StringBase::Printf(Tsy_SpeedKey::PLL_JITTER_KN, m, bw, n));
        }
        EXPECT_TRUE(d.Stream().Entries().empty())
            << part.part << ": " << (d.Stream().Entries().empty() ? "" : d.Stream().Entries()[0].text.str());
    }
}
