// The platform's core: the nullable reference, casts, property blocks, and the text field
// operations: whole-text separators, no regard to case, positions in characters.
#include "platform/core/property_block.h"
#include "platform/core/ref.h"
#include "platform/core/text.h"

#include <gtest/gtest.h>

#include <limits>
#include <random>

namespace {
struct Base {
    virtual ~Base() = default;
    int value = 7;
};
struct Derived : Base {};
struct Other : Base {};

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

// Separators are whole texts, found without regard to case and without overlap.
TEST(Text, NthFieldAndCountFields) {
    const struct {
        std::string source, separator;
        long long n;
        std::string field;
        long long count;
    } cases[] = {
        {"a", "x", 2, "", 1},
        {"Code reads 123", "Code reads", 2, " 123", 2},
        {"a,,b", ",", 2, "", 3},
        {"Adobe Illustrator ", " ", 3, "", 3},  // a trailing blank makes an empty last field
        {"a,b", ",", 0, "", 2},
        {"aaaa", "aa", 2, "", 3},
        {"Code reads 1 Code reads 2", "Code reads", 2, " 1 ", 3},
        {"caf\xC3\x89-x", "\xC3\xA9-", 2, "x", 2},
        {"\xFF\xFE\r\xC3", "\r", 2, "\xC3", 2},  // invalid UTF-8 is taken byte by byte
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.source + " / " + c.separator);
        EXPECT_EQ(NthField(c.source, c.separator, c.n), c.field);
        EXPECT_EQ(CountFields(c.source, c.separator), c.count);
    }
}

TEST(Text, InStrCountsCharactersFromOne) {
    EXPECT_EQ(InStr(0, "abc", ""), 0);
    EXPECT_EQ(InStr(2, "abcabc", "abc"), 4);
    EXPECT_EQ(InStr(0, "\xC3\xA9\xC3\xA9x", "x"), 3) << "two characters of two bytes each";
}

// Against a plain scan on random texts: a search that takes several bytes at a time must not
// miss or invent a match anywhere, at the start of a block of bytes or in the last few bytes.
TEST(Text, InStrAgreesWithAPlainScanOnRandomTexts) {
    std::mt19937 random(7);
    const std::string alphabet = "cCoOdDeE @`[{\r";  // with the bytes 0x20 away from letters
    const auto text = [&](size_t longest) {
        std::string out(random() % (longest + 1), ' ');
        for (char& c : out) {
            c = alphabet[random() % alphabet.size()];
        }
        return out;
    };
    const auto fold = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; };
    for (int i = 0; i < 20000; ++i) {
        const std::string source = text(i % 8 == 0 ? 700 : 40);  // long ones too
        const std::string find = text(3) + alphabet[random() % alphabet.size()];
        long long expected = 0;
        for (size_t at = 0; expected == 0 && at + find.size() <= source.size(); ++at) {
            if (std::equal(find.begin(), find.end(), source.begin() + static_cast<long>(at),
                           [&](char a, char b) { return fold(a) == fold(b); })) {
                expected = static_cast<long long>(at) + 1;
            }
        }
        ASSERT_EQ(InStr(0, source, find), expected) << "'" << source << "' '" << find << "'";
    }
}

// No words such as "inf" or "nan", only digits; beyond the range of a double the value is what a
// double makes of the text.
TEST(Text, ValReadsTheLeadingNumber) {
    const double infinity = std::numeric_limits<double>::infinity();
    const std::pair<const char*, double> cases[] = {
        {"022.5", 22.5}, {"-3", -3.0},        {"Settings", 0.0}, {"12abc", 12.0},
        {"1e3", 1000.0}, {"1e", 1.0},         {"inf", 0.0},      {"nan", 0.0},
        {".", 0.0},      {"1e999", infinity}, {"4e-320", 4e-320}};
    for (const auto& [text, value] : cases) {
        EXPECT_EQ(Val(text), value) << text;
    }
}

TEST(Text, Int64FromDoubleCutsTowardsZeroAndSaturates) {
    EXPECT_EQ(Int64FromDouble(-22.9), -22);
    EXPECT_EQ(Int64FromDouble(-1e300), std::numeric_limits<long long>::min());
    EXPECT_EQ(Int64FromDouble(std::numeric_limits<double>::infinity()),
              std::numeric_limits<long long>::max());
    EXPECT_EQ(Int64FromDouble(std::numeric_limits<double>::quiet_NaN()), 0);
}

}  // namespace
