// The platform's core: the nullable reference, casts, and property blocks.
#include "platform/property_block.h"
#include "platform/ref.h"

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

TEST(Ref, UsingNilRaisesNilObjectException) {
    Ref<Base> nothing;
    EXPECT_TRUE(nothing.IsNil());
    EXPECT_THROW(nothing->value, NilObjectException);
    EXPECT_THROW(*nothing, NilObjectException);
    Ref<Base> something = New<Derived>();
    EXPECT_EQ(something->value, 7);
}

TEST(Ref, CastsAreTested) {
    Ref<Base> derived = New<Derived>();
    EXPECT_FALSE(Cast<Derived>(derived).IsNil());
    EXPECT_THROW(Cast<Other>(derived), IllegalCastException);
    EXPECT_TRUE(Cast<Other>(Ref<Base>()).IsNil());
}

TEST(PropertyBlock, EveryValueTypeRoundTrips) {
    PropertyBlock block;
    block.Add("Visible", true)
        .Add("Enabled", false)
        .Add("Left", -2147483648LL)
        .Add("Width", 968LL)
        .Add("BackColor", ColorWord{0x00EDF3FE})
        .Add("TextSize", 12.5f)
        .Add("LineSpacing", 1.25)
        .Add("Title", std::string("Orbelane \xC3\xA9 \r\r tabs\tand blanks"))
        .Add("HelpTag", std::string());
    const auto entries = DecodePropertyBlock(block.Bytes());
    ASSERT_EQ(entries.size(), 9u);
    EXPECT_EQ(std::get<bool>(entries[0].second), true);
    EXPECT_EQ(std::get<bool>(entries[1].second), false);
    EXPECT_EQ(std::get<long long>(entries[2].second), -2147483648LL);
    EXPECT_EQ(std::get<long long>(entries[3].second), 968);
    EXPECT_EQ(std::get<ColorWord>(entries[4].second).value, 0x00EDF3FEu);
    EXPECT_EQ(std::get<float>(entries[5].second), 12.5f);
    EXPECT_EQ(std::get<double>(entries[6].second), 1.25);
    EXPECT_EQ(std::get<std::string>(entries[7].second), "Orbelane \xC3\xA9 \r\r tabs\tand blanks");
    EXPECT_EQ(std::get<std::string>(entries[8].second), "");
    EXPECT_EQ(entries[7].first, "Title");
}

TEST(PropertyBlock, TheBytesAreTheDocumentedLayout) {
    PropertyBlock block;
    block.Add("Visible", true)
        .Add("Width", 968LL)
        .Add("TextColor", ColorWord{0x112233})
        .Add("Name", std::string("ab"));
    const std::string expected = std::string("Visible \x01", 9) + "Width " +
                                 std::string("\xC8\x03\0\0\0\0\0\0", 8) + "TextColor " +
                                 std::string("\x33\x22\x11\x00", 4) + "Name " +
                                 std::string("\x02\0\0\0", 4) + "ab";
    EXPECT_EQ(block.Bytes(), expected);
}

TEST(PropertyBlock, AValueOfTheWrongTypeIsRefusedWhenBuilt) {
    PropertyBlock block;
    EXPECT_THROW(block.Add("Width", std::string("968")), IllegalCastException);
    EXPECT_THROW(block.Add("NoSuchProperty", true), IllegalCastException);
}

TEST(PropertyBlock, ATruncatedBlockRaisesInsteadOfReadingPastItsEnd) {
    PropertyBlock block;
    block.Add("Title", std::string("Orbelane"));
    const std::string bytes = block.Bytes();
    for (size_t cut = 1; cut < bytes.size(); ++cut) {
        EXPECT_ANY_THROW(DecodePropertyBlock(std::string_view(bytes).substr(0, cut))) << cut;
    }
}
