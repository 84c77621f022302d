// The platform's core: the nullable reference, casts, and property blocks.
#include "platform/core/property_block.h"
#include "platform/core/ref.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {
struct Base {
    virtual ~Base() = default;
    int value = 7;
};
struct Derived : Base {};
struct Other : Base {};
}  // namespace

TEST(Ref, NilRaisesAndCastsAreTested) {
    Ref<Base> nothing;
    EXPECT_TRUE(nothing.IsNil());
    EXPECT_THROW(nothing->value, NilObjectException);
    EXPECT_THROW(*nothing, NilObjectException);
    Ref<Base> something = New<Derived>();
    EXPECT_EQ(something->value, 7);
    EXPECT_FALSE(Cast<Derived>(something).IsNil());
    EXPECT_THROW(Cast<Other>(something), IllegalCastException);
    EXPECT_TRUE(Cast<Other>(Ref<Base>()).IsNil());
}

TEST(PropertyBlock, TheBytesAreTheDocumentedLayoutAndDecodeBack) {
    PropertyBlock block;
    block.Add("Visible", true)
        .Add("Left", -2147483648LL)
        .Add("TextColor", ColorWord{0x112233})
        .Add("TextSize", 12.5f)
        .Add("LineSpacing", 1.25)
        .Add("Name", std::string("ab"));
    const std::string expected =
        std::string("Visible \x01", 9) + "Left " + std::string("\0\0\0\x80\xFF\xFF\xFF\xFF", 8) +
        "TextColor " + std::string("\x33\x22\x11\x00", 4) + "TextSize " +
        std::string("\0\0\x48\x41", 4) + "LineSpacing " + std::string("\0\0\0\0\0\0\xF4\x3F", 8) +
        "Name " + std::string("\x02\0\0\0", 4) + "ab";
    EXPECT_EQ(block.Bytes(), expected);
    const auto entries = DecodePropertyBlock(block.Bytes());
    ASSERT_EQ(entries.size(), 6u);
    EXPECT_EQ(std::get<long long>(entries[1].second), -2147483648LL);
    EXPECT_EQ(std::get<ColorWord>(entries[2].second).value, 0x112233u);
    EXPECT_EQ(std::get<float>(entries[3].second), 12.5f);
    EXPECT_EQ(std::get<double>(entries[4].second), 1.25);
    EXPECT_EQ(entries[5].first, "Name");
    EXPECT_EQ(std::get<std::string>(entries[5].second), "ab");
}

// A value of the wrong type is refused when built; a truncated block raises instead of reading
// past its end.
TEST(PropertyBlock, WhatItCannotHoldRaises) {
    PropertyBlock block;
    EXPECT_THROW(block.Add("Width", std::string("968")), IllegalCastException);
    EXPECT_THROW(block.Add("NoSuchProperty", true), IllegalCastException);
    block.Add("Title", std::string("Orbelane"));
    const std::string bytes = block.Bytes();
    for (size_t cut = 1; cut < bytes.size(); ++cut) {
        EXPECT_ANY_THROW(DecodePropertyBlock(std::string_view(bytes).substr(0, cut))) << cut;
    }
}
