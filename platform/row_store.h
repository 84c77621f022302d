// RowStore: the texts of a list's rows in plain arrays. Each row is one packed record of
// length-prefixed fields in large chunks that never move, so a million rows cost little more
// than their bytes and growing never copies them.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

class RowStore {
  public:
    explicit RowStore(int fieldCount) : fieldCount_(fieldCount) {}

    int FieldCount() const { return fieldCount_; }
    void SetFieldCount(int fieldCount);  // drops all rows
    size_t Count() const { return rows_.size(); }
    void AddRow();
    // Valid until the next change of the store.
    std::string_view Field(size_t row, int field) const;
    void SetField(size_t row, int field, std::string_view text);
    void Clear();
    // Sorts the rows by one field, case aside, keeping the order of equal rows. Returns, for
    // each new position, the row's old position.
    std::vector<uint32_t> SortBy(int field, bool descending);

  private:
    static constexpr size_t kChunkSize = 1 << 20;

    uint64_t Append(std::string_view record);
    bool SetTailField(int field, std::string_view text);
    const char* RecordAt(uint64_t location) const;

    int fieldCount_;
    std::vector<std::unique_ptr<char[]>> chunks_;
    std::vector<size_t> chunkSizes_;
    size_t used_ = 0;  // bytes used in the last chunk
    std::vector<uint64_t> rows_;
    std::string scratch_;  // the record being rebuilt, kept to spare an allocation per cell
    uint64_t lastRecord_ = UINT64_MAX;
};
