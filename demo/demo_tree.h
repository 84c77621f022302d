// Demo trees: a results store of invented results, as the verifier plug-in would write it, and
// the Adobe folders that the installer looks for. The demo, the tests and the benchmarks use it.
#pragma once

#include <cstddef>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace demo {

// One stored result; an absent value is stored as NULL.
struct StoredResult {
    std::optional<std::string> id;
    std::optional<std::string> datetime;
    std::optional<std::string> document;
    std::optional<std::string> grade;
    std::optional<std::string> results;
};

enum class Layout { A, B };

// A report text as the plug-in writes it: lines ended by carriage returns.
std::string ReportText(Layout layout, const std::string& readValue, const std::string& codeType,
                       int bars);

// Results with realistic texts in both layouts; with `oddOnes`, every so often a malformed text
// or a NULL column. Each report lists `bars` bars in each block, or 12 to 19 when it is 0.
std::vector<StoredResult> InventedResults(size_t count, bool oddOnes = true, int bars = 0);

inline constexpr const char* kSchema =
    "create table results_store (id text primary key, datetime text, document text, "
    "grade text, results text)";

// Writes a new store at `file` (its folders are made) with the rows, in one transaction.
void WriteStore(const std::filesystem::path& file, const std::vector<StoredResult>& rows,
                const std::string& schema = kSchema);

// Adds rows to the results_store table of an existing store.
void AppendToStore(const std::filesystem::path& file, const std::vector<StoredResult>& rows);

// Writes a store of `count` invented results without holding them all in memory.
void WriteInventedStore(const std::filesystem::path& file, size_t count, int bars = 0);

// Where the program finds the store and the application data under a root.
std::filesystem::path StorePath(const std::filesystem::path& root);
std::filesystem::path ApplicationDataPath(const std::filesystem::path& root);

// A whole demo tree: a store of `results` invented results, Illustrator 22 and 23 and
// Acrobat DC folders; the /Applications Acrobat folders stay absent.
void MakeDemoTree(const std::filesystem::path& root, size_t results);

}  // namespace demo
