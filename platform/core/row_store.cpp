// Packed rows: a record is, for each field, a varint length and the bytes. A location is the
// chunk's number in the high half and the offset in the low half.
#include "platform/core/row_store.h"

#include <algorithm>
#include <cstring>
#include <numeric>

#include "platform/core/text.h"

namespace {

char* PutLength(char* out, size_t length) {
    while (length >= 0x80) {
        *out++ = static_cast<char>((length & 0x7F) | 0x80);
        length >>= 7;
    }
    *out++ = static_cast<char>(length);
    return out;
}

void PutLength(std::string& out, size_t length) {
    char bytes[10];  // a 64-bit length takes at most ten
    out.append(bytes, PutLength(bytes, length));
}

size_t LengthSize(size_t length) {
    size_t size = 1;
    while (length >= 0x80) {
        length >>= 7;
        ++size;
    }
    return size;
}

// The record being rebuilt is kept between calls, unless a huge text made it huge.
void ReleaseIfHuge(std::string& scratch, size_t limit) {
    if (scratch.capacity() > limit) {
        scratch = std::string();
    }
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

std::string_view FieldOf(const char* record, int field) {
    const char* at = record;
    for (int i = 0;; ++i) {
        const size_t length = GetLength(at);
        if (i == field) {
            return {at, length};
        }
        at += length;
    }
}

constexpr uint64_t kOffsetMask = 0xFFFFFFFF;

}  // namespace

void RowStore::SetFieldCount(int fieldCount) {
    Clear();
    fieldCount_ = fieldCount;
}

void RowStore::AddRow() {
    CommitTail();
    if (chunks_.empty()) {
        chunks_.push_back({std::make_unique_for_overwrite<char[]>(kChunkSize), kChunkSize, 0});
    }
    tailRecord_ = (static_cast<uint64_t>(chunks_.size() - 1) << 32) | chunks_.back().used;
    tailFields_ = 0;
    tailOpen_ = true;
    ++count_;
}

std::string_view RowStore::Field(size_t row, int field) const {
    if (tailOpen_ && row + 1 == count_) {
        return field < tailFields_ ? FieldOf(RecordAt(tailRecord_), field) : std::string_view();
    }
    return FieldOf(RecordAt(Location(row)), field);
}

void RowStore::SetField(size_t row, int field, std::string_view text) {
    if (tailOpen_ && row + 1 == count_ && field == tailFields_) {
        char* out = PutLength(ExtendTail(LengthSize(text.size()) + text.size()), text.size());
        std::memcpy(out, text.data(), text.size());
        ++tailFields_;
        return;
    }
    CommitTail();
    const uint64_t place = Location(row);
    const bool lastWritten = place == lastRecord_;
    if (!lastWritten) {
        MakePlaces();  // the new record will stand behind the last one, out of order
    }
    const char* old = RecordAt(place);
    std::string& record = scratch_;
    record.clear();
    for (int i = 0; i < fieldCount_; ++i) {
        const std::string_view value = i == field ? text : FieldOf(old, i);
        PutLength(record, value.size());
        record += value;
    }
    if (lastWritten) {
        DropLastRecord();  // written over rather than left behind
    }
    std::memcpy(Reserve(record.size()), record.data(), record.size());
    if (!inOrder_) {
        places_[row] = lastRecord_;
    } else if (row % kStride == 0) {
        marks_.back() = lastRecord_;
    }
    foundRow_ = SIZE_MAX;
    ReleaseIfHuge(scratch_, kChunkSize);
}

// A record never spans two chunks: one that outgrows its chunk moves, whole, to a new one.
char* RowStore::MoveTail(size_t bytes) {
    chunks_.reserve(chunks_.size() + 1);  // nothing below can fail half done
    Chunk* chunk = &chunks_.back();
    const size_t start = tailRecord_ & kOffsetMask;
    const size_t written = chunk->used - start;
    // Room for the rest of the row too: a huge field is not copied again by the next.
    const size_t size = written + bytes + kChunkSize;
    auto moved = std::make_unique_for_overwrite<char[]>(size);
    std::memcpy(moved.get(), chunk->bytes.get() + start, written);
    chunk->used = start;
    if (start == 0) {
        chunks_.pop_back();  // it held nothing else
    }
    chunks_.push_back({std::move(moved), size, written + bytes});
    tailRecord_ = static_cast<uint64_t>(chunks_.size() - 1) << 32;
    return chunks_.back().bytes.get() + written;
}

// The row being filled gets empty texts for the fields it never got, and is the last record.
void RowStore::CommitTail() {
    if (!tailOpen_) {
        return;
    }
    tailOpen_ = false;
    if (tailFields_ < fieldCount_) {
        const auto missing = static_cast<size_t>(fieldCount_ - tailFields_);
        std::memset(ExtendTail(missing), 0, missing);  // a length 0 is one zero byte
    }
    lastRecord_ = tailRecord_;
    const size_t row = count_ - 1;
    if (!inOrder_) {
        places_.push_back(lastRecord_);
    } else if (row % kStride == 0) {
        marks_.push_back(lastRecord_);
    }
}

// The last row's record is always the last one written; a chunk that it leaves empty goes.
void RowStore::DropLastRecord() {
    chunks_.back().used = static_cast<size_t>(lastRecord_ & kOffsetMask);
    if (chunks_.back().used == 0) {
        chunks_.pop_back();
    }
}

void RowStore::Clear() {
    tailOpen_ = false;
    chunks_.clear();
    chunks_.shrink_to_fit();
    count_ = 0;
    inOrder_ = true;
    marks_ = {};
    places_ = {};
    lastRecord_ = UINT64_MAX;
    foundRow_ = SIZE_MAX;
}

std::vector<uint32_t> RowStore::SortBy(int field, bool descending) {
    CommitTail();
    MakePlaces();
    std::vector<uint32_t> order(count_);
    std::iota(order.begin(), order.end(), 0u);
    std::stable_sort(order.begin(), order.end(), [&](uint32_t a, uint32_t b) {
        const int c = RuntimeStringCompare(FieldOf(RecordAt(places_[a]), field),
                                           FieldOf(RecordAt(places_[b]), field));
        return descending ? c > 0 : c < 0;
    });
    std::vector<uint64_t> sorted(count_);
    for (size_t i = 0; i < order.size(); ++i) {
        sorted[i] = places_[order[i]];
    }
    places_ = std::move(sorted);
    return order;
}

// Room for a record of `bytes` behind the last one; lastRecord_ is its location.
char* RowStore::Reserve(size_t bytes) {
    if (chunks_.empty() || chunks_.back().used + bytes > chunks_.back().size) {
        const size_t size = std::max(bytes, kChunkSize);
        chunks_.push_back({std::make_unique_for_overwrite<char[]>(size), size, 0});
    }
    Chunk& chunk = chunks_.back();
    lastRecord_ = (static_cast<uint64_t>(chunks_.size() - 1) << 32) | chunk.used;
    chunk.used += bytes;
    return chunk.bytes.get() + (lastRecord_ & kOffsetMask);
}

uint64_t RowStore::Location(size_t row) const {
    if (!inOrder_) {
        return places_[row];
    }
    const size_t written = tailOpen_ ? count_ - 1 : count_;  // the rows that have a record
    if (row + 1 == written) {
        return lastRecord_;
    }
    uint64_t at = 0;
    size_t from = 0;
    if (foundRow_ <= row && row - foundRow_ < row % kStride) {
        at = foundAt_;
        from = foundRow_;
    } else {
        at = marks_[row / kStride];
        from = row - row % kStride;
    }
    for (; from < row; ++from) {
        at = NextLocation(at);
    }
    foundRow_ = row;
    foundAt_ = at;
    return at;
}

// The record behind the one at `location`, in the same chunk or at the start of the next.
uint64_t RowStore::NextLocation(uint64_t location) const {
    const size_t chunk = location >> 32;
    const char* record = RecordAt(location);
    const char* at = record;
    for (int i = 0; i < fieldCount_; ++i) {
        at += GetLength(at);
    }
    const size_t end = (location & kOffsetMask) + static_cast<size_t>(at - record);
    if (end == chunks_[chunk].used) {
        return static_cast<uint64_t>(chunk + 1) << 32;
    }
    return (static_cast<uint64_t>(chunk) << 32) | end;
}

const char* RowStore::RecordAt(uint64_t location) const {
    return chunks_[location >> 32].bytes.get() + (location & kOffsetMask);
}

void RowStore::MakePlaces() {
    if (!inOrder_) {
        return;
    }
    places_.resize(count_);
    for (size_t row = 0; row < count_; ++row) {
        places_[row] = row % kStride == 0 ? marks_[row / kStride] : NextLocation(places_[row - 1]);
    }
    marks_ = {};
    inOrder_ = false;
    foundRow_ = SIZE_MAX;
}
