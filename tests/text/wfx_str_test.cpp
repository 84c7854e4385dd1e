#include "zor_basis/text/wfx_str.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(WFxStr, breathes) {
    WChar const* text = ZB_W("tray");
    WFxStr view(text);
    EXPECT_EQ(view.wstr(), text);
    EXPECT_EQ(view.size(), 4U);
    view.clear();
    EXPECT_EQ(view.wstr(), WStr::StrEmpty);
    EXPECT_EQ(view.size(), 0U);
}

TEST(WFxStr, takes_or_measures_the_length) {
    WChar const* text = ZB_W("abcdef");
    EXPECT_EQ(WFxStr().wstr(), WStr::StrEmpty);
    EXPECT_EQ(WFxStr(text, 3).size(), 3U);
    EXPECT_EQ(WFxStr(text, 0).size(), 6U);
    EXPECT_EQ(WFxStr(text, 100).size(), 100U);
    EXPECT_EQ(WFxStr(nullptr, 3).wstr(), WStr::StrEmpty);
    EXPECT_EQ(WFxStr(nullptr, 3).size(), 0U);
    WFxStr view;
    view.set(text);
    EXPECT_EQ(view.size(), 6U);
    view.set(text, 2);
    EXPECT_EQ(view.size(), 2U);
    view.set(text, 0);
    EXPECT_EQ(view.size(), 0U) << "set with a length measures nothing";
    EXPECT_EQ(view.wstr(), text);
}

TEST(WFxStr, Kept_wide_02_equal_means_the_very_pointer) {
    WChar const first[] = {'a', 0};
    WChar const second[] = {'a', 0};
    WFxStr const view(first);
    EXPECT_TRUE(view.equal(first));
    EXPECT_FALSE(view.equal(second));
    EXPECT_FALSE(view.equal(nullptr));
    EXPECT_TRUE(view == second) << "while comparing looks at the text";
}
