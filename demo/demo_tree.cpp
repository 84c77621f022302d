// Demo trees, written with the SQLite library as another program would write them.
#include "demo/demo_tree.h"

#include <sqlite3.h>

#include <fstream>
#include <memory>
#include <random>
#include <stdexcept>

namespace fs = std::filesystem;

namespace demo {

namespace {

const char* const kCodes[] = {"EAN 13", "UPC A", "EAN 8", "ITF 14", "Code 128"};
const char* const kDocuments[] = {"Cereal Box Front.ai",         "Label 250ml Bottle.pdf",
                                  "Carton Outer Case.ai",        "Sleeve Promo Pack.pdf",
                                  "Jar Lid Wrap - Version 3.ai", "Blister Card EU.pdf"};
const char* const kGrades[] = {"A", "A", "B", "B", "C", "D", "F"};

void Check(int code, sqlite3* db) {
    if (code != SQLITE_OK && code != SQLITE_DONE && code != SQLITE_ROW) {
        throw std::runtime_error(sqlite3_errmsg(db));
    }
}

std::string Digits(std::mt19937& random, int count) {
    std::string digits;
    for (int i = 0; i < count; ++i) {
        digits += static_cast<char>('0' + random() % 10);
    }
    return digits;
}

void WriteBytes(const fs::path& file, const std::string& bytes) {
    fs::create_directories(file.parent_path());
    std::ofstream(file, std::ios::binary) << bytes;
}

}  // namespace

std::string ReportText(Layout layout, const std::string& readValue, const std::string& codeType,
                       int bars) {
    const std::string reads = "Code reads " + readValue;
    const std::string is = "Code is " + codeType;
    std::string text = (layout == Layout::A ? reads + "\r" + is : is + "\r" + reads) + "\r";
    text += "\r";
    text += "Symbol Length 29.83 mm\r";
    text += "Code is Sized at 80 %\r";
    text += "BWR Measured As 15 mic\r";
    text += "Bar Deviance 6 mic\r";
    text += "All bars within tolerance\r";
    text += "Actual Measurements = +- mic 0\r";
    for (int bar = 1; bar <= bars; ++bar) {
        text += "Bar " + std::to_string(bar) + " " + std::to_string(330 * (1 + bar % 4)) + "\r";
    }
    text += "Bar/Space Deviances = +- mic 0";
    for (int bar = 1; bar <= bars; ++bar) {
        text += "\rBar " + std::to_string(bar) + (bar % 2 ? " +" : " -") + std::to_string(bar % 7);
    }
    return text;
}

std::vector<StoredResult> InventedResults(size_t count, bool oddOnes, int bars) {
    std::mt19937 random(20181104);
    std::vector<StoredResult> rows;
    rows.reserve(count);
    for (size_t i = 0; i < count; ++i) {
        StoredResult row;
        row.id = std::to_string(i + 1);
        char datetime[32];
        std::snprintf(datetime, sizeof datetime, "2018-%02zu-%02zu %02zu:%02zu:%02zu", 1 + i % 12,
                      1 + i % 28, 8 + i % 10, i % 60, (i * 7) % 60);
        row.datetime = datetime;
        row.document = kDocuments[random() % std::size(kDocuments)];
        row.grade = kGrades[random() % std::size(kGrades)];
        const Layout layout = i % 3 == 2 ? Layout::B : Layout::A;
        row.results = ReportText(layout, Digits(random, 13), kCodes[random() % std::size(kCodes)],
                                 bars > 0 ? bars : 12 + static_cast<int>(random() % 8));
        if (oddOnes && i % 97 == 41) {
            row.results = "Verifier stopped: no barcode found in the selection";
        } else if (oddOnes && i % 89 == 17) {
            row.document.reset();
        } else if (oddOnes && i % 101 == 63) {
            row.grade.reset();
        }
        rows.push_back(std::move(row));
    }
    return rows;
}

void WriteStore(const fs::path& file, const std::vector<StoredResult>& rows,
                const std::string& schema) {
    fs::create_directories(file.parent_path());
    sqlite3* raw = nullptr;
    Check(sqlite3_open(file.c_str(), &raw), raw);
    std::unique_ptr<sqlite3, decltype(&sqlite3_close)> db(raw, sqlite3_close);
    Check(sqlite3_exec(raw, schema.c_str(), nullptr, nullptr, nullptr), raw);
    db.reset();
    if (!rows.empty()) {
        AppendToStore(file, rows);  // a table without these columns stays as it is
    }
}

void AppendToStore(const fs::path& file, const std::vector<StoredResult>& rows) {
    sqlite3* raw = nullptr;
    Check(sqlite3_open(file.c_str(), &raw), raw);
    std::unique_ptr<sqlite3, decltype(&sqlite3_close)> db(raw, sqlite3_close);
    Check(sqlite3_exec(raw, "begin", nullptr, nullptr, nullptr), raw);
    sqlite3_stmt* insert = nullptr;
    Check(sqlite3_prepare_v2(raw,
                             "insert into results_store (id, datetime, document, grade, results) "
                             "values (?, ?, ?, ?, ?)",
                             -1, &insert, nullptr),
          raw);
    for (const StoredResult& row : rows) {
        int column = 1;
        for (const auto* value :
             {&row.id, &row.datetime, &row.document, &row.grade, &row.results}) {
            if (*value) {
                sqlite3_bind_text(insert, column, (*value)->data(),
                                  static_cast<int>((*value)->size()), SQLITE_TRANSIENT);
            } else {
                sqlite3_bind_null(insert, column);
            }
            ++column;
        }
        Check(sqlite3_step(insert), raw);
        sqlite3_reset(insert);
    }
    sqlite3_finalize(insert);
    Check(sqlite3_exec(raw, "commit", nullptr, nullptr, nullptr), raw);
}

void WriteInventedStore(const fs::path& file, size_t count, int bars) {
    constexpr size_t kBatch = 50000;
    for (size_t done = 0; done < count; done += kBatch) {
        std::vector<StoredResult> rows =
            InventedResults(std::min(kBatch, count - done), false, bars);
        for (size_t i = 0; i < rows.size(); ++i) {
            rows[i].id = std::to_string(done + i + 1);
        }
        if (done == 0) {
            WriteStore(file, rows);
        } else {
            AppendToStore(file, rows);
        }
    }
}

fs::path StorePath(const fs::path& root) {
    return root / "Library/Application Support/Tamsorel/results.db";
}

fs::path ApplicationDataPath(const fs::path& root) {
    return root / "Users/user/Library/Application Support";
}

void MakeDemoTree(const fs::path& root, size_t results) {
    WriteStore(StorePath(root), InventedResults(results));
    const fs::path adobe = ApplicationDataPath(root) / "Adobe";
    for (const char* version : {"Adobe Illustrator 22", "Adobe Illustrator 23"}) {
        fs::create_directories(adobe / version / "en_US" / "Plug-ins");
        WriteBytes(adobe / version / ".DS_Store", "");
    }
    fs::create_directories(adobe / "Acrobat" / "DC" / "Plug-ins");
}

}  // namespace demo
