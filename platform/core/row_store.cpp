// Packed rows: a record is, for each field, a varint length and the bytes. A change to a row
// writes its whole record anew behind the last one; the last record itself is written over.
#include "platform/core/row_store.h"

#include <algorithm>
#include <cstring>
#include <numeric>

#include "platform/core/text.h"

namespace {

constexpr size_t kChunkSize = 1 << 20;
constexpr uint64_t kOffsetMask = 0xFFFFFFFF;
constexpr size_t kMaxLengthBytes = 10;  // of a 64-bit length

char* PutLength(char* out, size_t length) {
    while (length >= 0x80) {
        *out++ = static_cast<char>((length & 0x7F) | 0x80);
        length >>= 7;
    }
    *out++ = static_cast<char>(length);
    return out;
}

void PutLength(std::string& out, size_t length) {
    char bytes[kMaxLengthBytes];
    out.append(bytes, PutLength(bytes, length));
}

size_t GetLength(const char*& at) {
    size_t length = 0;
    for (int shift = 0;; shift += 7) {
        const auto byte = static_cast<unsigned char>(*at++);
        length |= static_cast<size_t>(byte & 0x7F) << shift;
        if (byte < 0x80) {
            return length;
        }
    }
}

// The start of a record's field.
const char* FieldStart(const char* record, int field) {
    for (int i = 0; i < field; ++i) {
        record += GetLength(record);
    }
    return record;
}

}  // namespace

void RowStore::SetFieldCount(int fieldCount) {
    Clear();
    fieldCount_ = fieldCount;
}

void RowStore::AddRow() {
    places_.push_back(Append(std::string(static_cast<size_t>(fieldCount_), '\0')));
}

std::string_view RowStore::Field(size_t row, int field) const {
    const char* at = FieldStart(RecordAt(places_[row]), field);
    const size_t length = GetLength(at);
    return {at, length};
}

void RowStore::SetField(size_t row, int field, std::string_view text) {
    const uint64_t place = places_[row];
    const char* record = RecordAt(place);
    Chunk& last = chunks_.back();
    const bool inLastChunk = place >> 32 == chunks_.size() - 1;
    // A list load fills its last row field by field. While this field and those behind it are
    // empty, the chunk ends in their zero lengths, one byte each, and the field is written
    // there, where there is room. Writing the whole record anew made the load 9% longer.
    const char* start = FieldStart(record, field);
    const auto rest = static_cast<size_t>(fieldCount_ - field);
    if (inLastChunk && last.bytes.get() + last.used - start == static_cast<ptrdiff_t>(rest) &&
        last.used + kMaxLengthBytes + text.size() <= last.size) {
        char* out = PutLength(last.bytes.get() + (last.used - rest), text.size());
        std::copy(text.begin(), text.end(), out);  // an empty view may have no data at all
        std::memset(out + text.size(), 0, rest - 1);
        last.used = static_cast<size_t>(out - last.bytes.get()) + text.size() + rest - 1;
        return;
    }
    record_.clear();
    const char* at = record;
    for (int i = 0; i < fieldCount_; ++i) {
        const size_t length = GetLength(at);
        PutLength(record_, i == field ? text.size() : length);
        record_.append(i == field ? text : std::string_view(at, length));
        at += length;
    }
    // The last record is written over rather than left behind.
    if (inLastChunk && at == last.bytes.get() + last.used) {
        last.used = place & kOffsetMask;
        if (last.used == 0) {
            chunks_.pop_back();  // it held this record alone
        }
    }
    places_[row] = Append(record_);
    if (record_.capacity() > kChunkSize) {
        record_ = std::string();  // a huge text goes back to the system
    }
}

void RowStore::Clear() {
    chunks_ = std::vector<Chunk>();
    places_ = {};
}

std::vector<uint32_t> RowStore::SortBy(int field, bool descending) {
    std::vector<uint32_t> order(places_.size());
    std::iota(order.begin(), order.end(), 0u);
    std::stable_sort(order.begin(), order.end(), [&](uint32_t a, uint32_t b) {
        const int c = RuntimeStringCompare(Field(a, field), Field(b, field));
        return descending ? c > 0 : c < 0;
    });
    std::vector<uint64_t> sorted(places_.size());
    for (size_t i = 0; i < order.size(); ++i) {
        sorted[i] = places_[order[i]];
    }
    places_ = std::move(sorted);
    return order;
}

const char* RowStore::RecordAt(uint64_t place) const {
    return chunks_[place >> 32].bytes.get() + (place & kOffsetMask);
}

// A record never spans two chunks: one that does not fit starts a new chunk, of its own size
// and room for more if it is larger than a chunk.
uint64_t RowStore::Append(std::string_view record) {
    if (chunks_.empty() || chunks_.back().used + record.size() > chunks_.back().size) {
        const size_t size = std::max(record.size() + kChunkSize / 16, kChunkSize);
        chunks_.push_back({std::make_unique_for_overwrite<char[]>(size), size, 0});
    }
    Chunk& chunk = chunks_.back();
    const uint64_t place = (static_cast<uint64_t>(chunks_.size() - 1) << 32) | chunk.used;
    std::copy(record.begin(), record.end(), chunk.bytes.get() + chunk.used);
    chunk.used += record.size();
    return place;
}
