// RowStore: the texts of a list's rows in plain arrays. Each row is one packed record of
// length-prefixed fields, in large chunks that never move, and a table holds each row's place.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

class RowStore {
  public:
    explicit RowStore(int fieldCount) : fieldCount_(fieldCount) {}

    void SetFieldCount(int fieldCount);  // drops all rows
    size_t Count() const { return places_.size(); }
    void AddRow();
    // Valid until the next change of the store.
    std::string_view Field(size_t row, int field) const;
    void SetField(size_t row, int field, std::string_view text);
    void Clear();
    // Sorts the rows by one field, case aside, keeping the order of equal rows. Returns, for
    // each new position, the row's old position.
    std::vector<uint32_t> SortBy(int field, bool descending);

  private:
    struct Chunk {
        std::unique_ptr<char[]> bytes;
        size_t size = 0;
        size_t used = 0;
    };

    const char* RecordAt(uint64_t place) const;
    uint64_t Append(std::string_view record);

    int fieldCount_;
    std::vector<Chunk> chunks_;
    // Each row's record: the chunk's number in the high half, the offset in the low half.
    std::vector<uint64_t> places_;
    std::string record_;  // the record being rebuilt, kept to spare an allocation per cell
};
