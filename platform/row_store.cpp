// Packed rows: a record is, for each field, a varint length and the bytes.
#include "platform/row_store.h"

#include <algorithm>
#include <cstring>
#include <numeric>

#include "platform/text.h"

namespace {

void PutLength(std::string& out, size_t length) {
    while (length >= 0x80) {
        out += static_cast<char>((length & 0x7F) | 0x80);
        length >>= 7;
    }
    out += static_cast<char>(length);
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

}  // namespace

void RowStore::SetFieldCount(int fieldCount) {
    Clear();
    fieldCount_ = fieldCount;
}

void RowStore::AddRow() {
    rows_.push_back(Append(std::string(fieldCount_, '\0')));
}

std::string_view RowStore::Field(size_t row, int field) const {
    return FieldOf(RecordAt(rows_[row]), field);
}

void RowStore::SetField(size_t row, int field, std::string_view text) {
    if (rows_[row] == lastRecord_ && SetTailField(field, text)) {
        return;
    }
    const char* old = RecordAt(rows_[row]);
    std::string& record = scratch_;
    record.clear();
    for (int i = 0; i < fieldCount_; ++i) {
        const std::string_view value = i == field ? text : FieldOf(old, i);
        PutLength(record, value.size());
        record += value;
    }
    if (rows_[row] == lastRecord_ && chunkSizes_.back() == kChunkSize) {
        // The last record written: write over it rather than leave it behind.
        used_ = static_cast<size_t>(lastRecord_ & 0xFFFFFFFF);
    }
    rows_[row] = Append(record);
}

// Filling the last row from left to right: when every field behind `field` is still empty,
// the record is cut at `field` and written on from there, without copying what stands ahead.
bool RowStore::SetTailField(int field, std::string_view text) {
    if (chunkSizes_.back() != kChunkSize) {
        return false;
    }
    char* record = chunks_.back().get() + (lastRecord_ & 0xFFFFFFFF);
    const char* at = record;
    for (int i = 0; i < field; ++i) {
        at += GetLength(at);
    }
    char* fieldStart = const_cast<char*>(at);
    GetLength(at);  // the old value of the field itself may be anything
    for (int i = field + 1; i < fieldCount_; ++i) {
        if (*at++ != 0) {
            return false;
        }
    }
    std::string& tail = scratch_;
    tail.clear();
    PutLength(tail, text.size());
    tail += text;
    tail.append(static_cast<size_t>(fieldCount_ - field - 1), '\0');
    const size_t start = static_cast<size_t>(fieldStart - chunks_.back().get());
    if (start + tail.size() > kChunkSize) {
        return false;
    }
    std::memcpy(fieldStart, tail.data(), tail.size());
    used_ = start + tail.size();
    return true;
}

void RowStore::Clear() {
    chunks_.clear();
    chunkSizes_.clear();
    rows_.clear();
    rows_.shrink_to_fit();
    used_ = 0;
    lastRecord_ = UINT64_MAX;
}

std::vector<uint32_t> RowStore::SortBy(int field, bool descending) {
    std::vector<uint32_t> order(rows_.size());
    std::iota(order.begin(), order.end(), 0u);
    std::stable_sort(order.begin(), order.end(), [&](uint32_t a, uint32_t b) {
        const int c = RuntimeStringCompare(Field(a, field), Field(b, field));
        return descending ? c > 0 : c < 0;
    });
    std::vector<uint64_t> sorted(rows_.size());
    for (size_t i = 0; i < order.size(); ++i) {
        sorted[i] = rows_[order[i]];
    }
    rows_ = std::move(sorted);
    lastRecord_ = UINT64_MAX;
    return order;
}

// A location is the chunk's number in the high half and the offset in the low half.
uint64_t RowStore::Append(std::string_view record) {
    if (chunks_.empty() || chunkSizes_.back() != kChunkSize || used_ + record.size() > kChunkSize) {
        const size_t size = std::max(kChunkSize, record.size());
        chunks_.push_back(std::make_unique<char[]>(size));
        chunkSizes_.push_back(size);
        used_ = 0;
    }
    std::memcpy(chunks_.back().get() + used_, record.data(), record.size());
    lastRecord_ = (static_cast<uint64_t>(chunks_.size() - 1) << 32) | used_;
    used_ += record.size();
    if (chunkSizes_.back() != kChunkSize) {
        used_ = chunkSizes_.back();  // an oversized record has its chunk to itself
    }
    return lastRecord_;
}

const char* RowStore::RecordAt(uint64_t location) const {
    return chunks_[location >> 32].get() + (location & 0xFFFFFFFF);
}
