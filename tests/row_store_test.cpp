// RowStore against a plain vector of rows: the same random operations on both, then the same
// texts, so rewrites in place, chunk boundaries, long lengths and oversized cells are covered.
#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <string>
#include <vector>

#include "platform/core/row_store.h"
#include "platform/core/text.h"

namespace {

constexpr int kFields = 4;
constexpr size_t kMiB = 1 << 20;

using Rows = std::vector<std::vector<std::string>>;

void ExpectSame(const RowStore& store, const Rows& model, const std::string& step) {
    ASSERT_EQ(store.Count(), model.size()) << step;
    for (size_t row = 0; row < model.size(); ++row) {
        for (int field = 0; field < kFields; ++field) {
            ASSERT_EQ(store.Field(row, field), model[row][field])
                << step << ": row " << row << " field " << field;
        }
    }
}

struct Driver {
    int Pick(size_t bound) { return static_cast<int>(random() % bound); }
    // Mostly short texts, with lengths around the one- and two-byte length prefixes, some of
    // a few kilobytes to fill chunks, and now and then one larger than a whole chunk.
    std::string Text() {
        static const size_t kEdges[] = {0, 1, 127, 128, 129, 16383, 16384, 16385};
        const int kind = Pick(100);
        const size_t length = kind < 50   ? static_cast<size_t>(Pick(24))
                              : kind < 75 ? kEdges[Pick(std::size(kEdges))]
                              : kind < 98 ? 1000 + static_cast<size_t>(Pick(60000))
                                          : kMiB + static_cast<size_t>(Pick(4096));
        return std::string(length, static_cast<char>('a' + Pick(26)));
    }
    std::mt19937 random;
};

// InOrder is a list load: rows added and filled only at the end, mostly field by field in place,
// and read back at random; then one earlier row changes. Otherwise any row is rewritten, most
// often one that is not the last, with sorts and clears.
void AgreesWithAPlainVectorOfRows(unsigned seed, bool inOrder) {
    Driver driver{std::mt19937(seed)};
    RowStore store(kFields);
    Rows model;
    int nextField = 0;  // a load fills the last row's fields in order, now and then not
    for (int step = 0; step < 4000; ++step) {
        const int op = driver.Pick(100);
        const std::string name = "step " + std::to_string(step);
        if (op < (inOrder ? 40 : 30) || model.empty()) {
            store.AddRow();
            model.emplace_back(kFields);
            nextField = 0;
        } else if (op < 97) {
            const bool last = inOrder || op < 60;
            const size_t row =
                last ? model.size() - 1 : static_cast<size_t>(driver.Pick(model.size()));
            const bool inTurn = inOrder && nextField < kFields && driver.Pick(8) != 0;
            const int field = inTurn ? nextField : driver.Pick(kFields);
            nextField = field + 1;
            const std::string text = driver.Text();
            store.SetField(row, field, text);
            model[row][field] = text;
        } else if (inOrder) {
            const size_t row = static_cast<size_t>(driver.Pick(model.size()));
            ASSERT_EQ(store.Field(row, 0), model[row][0]) << name << " row " << row;
        } else if (op < 99) {
            const int field = driver.Pick(kFields);
            const bool descending = driver.Pick(2) == 1;
            store.SortBy(field, descending);
            std::stable_sort(model.begin(), model.end(), [&](const auto& a, const auto& b) {
                const int c = RuntimeStringCompare(a[field], b[field]);
                return descending ? c > 0 : c < 0;
            });
            ExpectSame(store, model, name + " (sort)");
        } else {
            store.Clear();
            model.clear();
        }
        if (step % 250 == 0) {
            ExpectSame(store, model, name);
        }
    }
    ExpectSame(store, model, "end");
    if (inOrder && !model.empty()) {
        store.SetField(0, 1, "changed");  // an earlier row, written anew behind the last
        model[0][1] = "changed";
        store.AddRow();
        model.emplace_back(kFields);
        ExpectSame(store, model, "after a change to the first row");
    }
}

TEST(RowStore, AgreesWithAPlainVectorOfRows) {
    for (const auto& [seed, inOrder] :
         {std::pair{1u, false}, {2u, false}, {42u, false}, {1u, true}, {3u, true}}) {
        SCOPED_TRACE(::testing::Message() << (inOrder ? "in order" : "any") << ", seed " << seed);
        AgreesWithAPlainVectorOfRows(seed, inOrder);
    }
}

}  // namespace
