// The portability library: strings, number reading and the shared-object
// registry.

#include "port/Exception.h"
#include "port/SharedResourceMgr.h"
#include "port/StringBase.h"
#include "port/UtStr.h"

#include <gtest/gtest.h>

#include <climits>

TEST(StringBase, FormatsLikePrintf)
{
    StringBase s;
    s.Format("%3.3f ns at %d %s", 10.0, 7, "MHz");
    EXPECT_EQ(s, "10.000 ns at 7 MHz");
    EXPECT_EQ(StringBase::Printf("%s_INST%d", "DCM_ADV", 2), "DCM_ADV_INST2");
    // Longer than any fixed buffer would allow.
    std::string wide(5000, 'x');
    EXPECT_EQ(StringBase::Printf("%s!", wide.c_str()).GetLength(), 5001u);
}

TEST(StringBase, CompareTypeOneIgnoresCase)
{
    struct Case {
        const char* a;
        const char* b;
        int type;
        bool equal;
    } cases[] = {
        {"None", "NONE", 1, true},  {"None", "NONE", 0, false}, {"dcm_pll", "DCM_PLL", 1, true},
        {"CLK0", "CLK0", 0, true},  {"CLK0", "CLK00", 1, false}, {"", "", 1, true},
    };
    for (const auto& c : cases)
        EXPECT_EQ(StringBase(c.a).Compare(c.b, c.type) == 0, c.equal) << c.a << " vs " << c.b;
    EXPECT_LT(StringBase("a").Compare("B", 1), 0);
}

TEST(StringBase, TrimSearchTruncateArg)
{
    EXPECT_EQ(StringBase(" \tDCM_INST \t").Trim(), "DCM_INST");
    EXPECT_EQ(StringBase("   ").Trim(), "");
    EXPECT_EQ(StringBase("TSY_CLKBUFTYPE12_NOEDIT").GetIndexOfString("_NOEDIT"), 16);
    EXPECT_EQ(StringBase("abc").GetIndexOfString("x"), -1);
    EXPECT_EQ(StringBase("abc").GetIndexOfString("c", 5), -1);
    EXPECT_EQ(StringBase("6.3.1").Truncate(3), "6.3");
    EXPECT_EQ(StringBase("ab").Truncate(9), "ab");
    StringBase m("Error loading speedsfile for %1.");
    EXPECT_EQ(m.Arg(1, "t5da1-1"), "Error loading speedsfile for t5da1-1.");
    EXPECT_EQ(StringBase("%1 and %1, %2").Arg(1, "x").Arg(2, "y"), "x and x, y");
    EXPECT_EQ(StringBase("abc")[7], '\0');
}

TEST(UtStr, ReadsNumbersWithoutThrowing)
{
    EXPECT_EQ(UT_STR::AToI("42abc"), 42);
    EXPECT_EQ(UT_STR::AToI("junk"), 0);
    EXPECT_EQ(UT_STR::AToI("99999999999999"), INT_MAX);
    EXPECT_DOUBLE_EQ(UT_STR::AToF("2.5e1"), 25.0);
    EXPECT_DOUBLE_EQ(UT_STR::AToF("inf"), 0.0);
    int n = 0;
    EXPECT_TRUE(UT_STR::ParseInt(" 12 ", n));
    EXPECT_EQ(n, 12);
    EXPECT_FALSE(UT_STR::ParseInt("12x", n));
    EXPECT_FALSE(UT_STR::ParseInt("", n));
    double d = 0;
    EXPECT_TRUE(UT_STR::ParseDouble("100.5", d));
    EXPECT_FALSE(UT_STR::ParseDouble("1e999", d));
    EXPECT_TRUE(UT_STR::IsDigit('7'));
    EXPECT_FALSE(UT_STR::IsAlpha('_'));
}

TEST(SharedRegistry, SharesObjectsByKeyAndCountsUsers)
{
    using Registry = Util::Details::SharedRegistry<int, std::string>;
    auto& reg = Util::Details::SharedRegistryFor<int, std::string>("test-registry");
    auto& again = Util::Details::SharedRegistryFor<int, std::string>("test-registry");
    EXPECT_EQ(&reg, &again);
    EXPECT_EQ(reg.Get(1), nullptr);
    std::string* made = reg.Create(1, std::make_unique<std::string>("one"));
    EXPECT_EQ(reg.Get(1), made);
    EXPECT_EQ(reg.UseCount(1), 2u);
    try {
        reg.Create(1, std::make_unique<std::string>("again"));
        FAIL() << "a second Create must be refused";
    } catch (const Util::IllegalMethodCalledException& e) {
        EXPECT_STREQ(e.what(), "Shared Object already exists. Use Get() instead of Create().");
    }
    reg.Release(1);
    EXPECT_EQ(reg.UseCount(1), 1u);
    reg.Release(1);
    EXPECT_EQ(reg.Get(1), nullptr);
    static_assert(std::is_base_of_v<Util::Details::SharedRegistryBase, Registry>);
}
