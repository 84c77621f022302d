// RowStore: the texts of a list's rows in plain arrays. Each row is one packed record of
// length-prefixed fields in large chunks that never move. While rows are only added and filled
// in order, their records lie one behind the other, and only every 64th row's place is kept:
// a million rows then cost little more than their bytes. A sort, or a change to an earlier
// row, makes a table of every row's place.
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
    size_t Count() const { return count_; }
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
    static constexpr size_t kStride = 64;

    struct Chunk {
        std::unique_ptr<char[]> bytes;
        size_t size = 0;
        size_t used = 0;
    };

    char* Reserve(size_t bytes);
    // Room for `bytes` more of the row being filled, most often where it stands.
    char* ExtendTail(size_t bytes) {
        Chunk& chunk = chunks_.back();
        if (chunk.used + bytes > chunk.size) {
            return MoveTail(bytes);
        }
        char* out = chunk.bytes.get() + chunk.used;
        chunk.used += bytes;
        return out;
    }
    char* MoveTail(size_t bytes);
    void CommitTail();
    void DropLastRecord();
    uint64_t Location(size_t row) const;
    uint64_t NextLocation(uint64_t location) const;
    const char* RecordAt(uint64_t location) const;
    void MakePlaces();

    int fieldCount_;
    std::vector<Chunk> chunks_;
    size_t count_ = 0;
    // In order: the place of every kStride-th row. Otherwise, `places_` holds every row's.
    bool inOrder_ = true;
    std::vector<uint64_t> marks_;
    std::vector<uint64_t> places_;
    uint64_t lastRecord_ = UINT64_MAX;  // the last row's record
    // The row found last, so that reading rows one after another takes one step each.
    mutable size_t foundRow_ = SIZE_MAX;
    mutable uint64_t foundAt_ = 0;
    std::string scratch_;  // the record being rebuilt, kept to spare an allocation per cell
    // The last row while it is filled: its record grows behind the last one as its fields
    // come in order, so filling a row copies each text once. A field out of order closes it.
    bool tailOpen_ = false;
    uint64_t tailRecord_ = 0;
    int tailFields_ = 0;
};
