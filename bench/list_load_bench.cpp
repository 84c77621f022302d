// The list load and the report open on big stores. For each store it times, in one run, the
// load from PagePanel1.Value = 1 to the end of its loop against two yardsticks on the same
// file: the floor, a loop in this process that prepares the list query and asks SQLite for the
// text of every column of every row, and `sqlite3 FILE "select * from results_store"`. It
// reports the peak memory of a load against the bytes of the shown columns, the time for the
// rows to reach the view, and the double-click open.
//
//   bench_list_load [RUNS] [FOLDER] [COUNT]  (stores are made in FOLDER once and kept; with
//                                             COUNT, one store of COUNT invented results only)
//   bench_list_load --load ROOT              (one measured load in this process; used by the
//                                             above)
#include <QApplication>
#include <QElapsedTimer>

#include <sqlite3.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>
#include <vector>

#include "platform/runtime.h"
#include "scripts/demo_tree.h"
#include "shell/startup.h"
#include "shell/window1.h"
#include "timing.h"

namespace fs = std::filesystem;

namespace {

long StatusKilobytes(const char* key) {
    std::ifstream status("/proc/self/status");
    std::string line;
    while (std::getline(status, line)) {
        if (line.rfind(key, 0) == 0) {
            return std::atol(line.c_str() + std::string(key).size() + 1);
        }
    }
    return 0;
}

// One load in a fresh process: prints "load flush peak shown open" (ms, ms, bytes, bytes, ms).
int MeasureOneLoad(int argc, char** argv, const char* root) {
    setenv("ORBELANE_ROOT", root, 1);
    RuntimeInit(argc, argv);
    _EarlyStartup();
    auto window = Window1();
    QCoreApplication::processEvents();
    const long baseline = StatusKilobytes("VmRSS");
    QElapsedTimer timer;
    timer.start();
    window->PagePanel1()->SetValue(1);
    const double load = timer.nsecsElapsed() / 1e6;
    timer.restart();
    QCoreApplication::processEvents();  // the rows reach the view
    const double flush = timer.nsecsElapsed() / 1e6;
    const long peak = StatusKilobytes("VmHWM") - baseline;

    auto list = window->Listbox1();
    size_t shown = 0;
    for (long long row = 0; row < list->ListCount(); ++row) {
        for (int column = 0; column < 4; ++column) {
            shown += list->Cell(row, column).size();
        }
    }
    std::vector<double> opens;
    for (int i = 0; i < 21; ++i) {
        list->SetListIndex(list->ListCount() * i / 21);
        timer.restart();
        window->Listbox1_DoubleClick(*list);
        opens.push_back(timer.nsecsElapsed() / 1e6);
        window->PagePanel1()->SetValue(0);
    }
    std::printf("%.2f %.2f %ld %zu %.3f %lld\n", load, flush, peak * 1024, shown, Median(opens),
                list->ListCount());
    std::fflush(stdout);
    std::_Exit(0);
}

// The floor: SQLite handing over every column of every row as text, nothing done with it.
double FloorMilliseconds(const fs::path& store) {
    size_t bytes = 0;
    const double milliseconds = Milliseconds([&] {
        sqlite3* db = nullptr;
        sqlite3_open_v2(store.c_str(), &db, SQLITE_OPEN_READONLY, nullptr);
        sqlite3_stmt* statement = nullptr;
        sqlite3_prepare_v2(db, "select * from results_store", -1, &statement, nullptr);
        const int columns = sqlite3_column_count(statement);
        while (sqlite3_step(statement) == SQLITE_ROW) {
            for (int column = 0; column < columns; ++column) {
                if (sqlite3_column_text(statement, column)) {
                    bytes += static_cast<size_t>(sqlite3_column_bytes(statement, column));
                }
            }
        }
        sqlite3_finalize(statement);
        sqlite3_close(db);
    });
    if (bytes == 0) {
        std::fprintf(stderr, "the floor read nothing\n");
    }
    return milliseconds;
}

struct Shape {
    const char* name;
    size_t count;
    int bars;  // 0: 12 to 19 bars, as invented
};

void MeasureStore(const fs::path& folder, const Shape& shape, int runs) {
    const std::string self = fs::canonical("/proc/self/exe").string();
    const fs::path root = folder / (std::to_string(shape.count) +
                                    (shape.bars ? "-bars" + std::to_string(shape.bars) : ""));
    const fs::path store = demo::StorePath(root);
    if (!fs::exists(store)) {
        std::printf("making a store of %zu results...\n", shape.count);
        std::fflush(stdout);
        demo::WriteInventedStore(store, shape.count, shape.bars);
    }
    std::vector<double> loads, floors, cli, flushes, opens;
    double peak = 0, shown = 0;
    for (int i = 0; i < runs; ++i) {
        const std::string command =
            "QT_QPA_PLATFORM=offscreen '" + self + "' --load '" + root.string() + "' 2>/dev/null";
        FILE* child = popen(command.c_str(), "r");
        double load = 0, flush = 0, open = 0;
        long long rows = 0;
        if (std::fscanf(child, "%lf %lf %lf %lf %lf %lld", &load, &flush, &peak, &shown, &open,
                        &rows) != 6 ||
            rows != static_cast<long long>(shape.count)) {
            std::fprintf(stderr, "the load did not report\n");
        }
        pclose(child);
        loads.push_back(load);
        flushes.push_back(flush);
        opens.push_back(open);
        floors.push_back(FloorMilliseconds(store));
        cli.push_back(TimeCommand("sqlite3 '" + store.string() +
                                  "' \"select * from results_store\" > /dev/null"));
    }
    const bool million = shape.count >= 1000000;
    const double l = Median(loads);
    const double f = Median(floors);
    const double c = Median(cli);
    const double average = static_cast<double>(fs::file_size(store)) / shape.count;
    std::printf("%zu results, %s (%.0f bytes a row on file), median of %d:\n", shape.count,
                shape.name, average, runs);
    std::printf("  list load %.0f ms, floor %.0f ms: ratio %.2f%s\n", l, f, l / f,
                million ? " (target <= 1.5)" : "");
    std::printf("  sqlite3 CLI %.0f ms: ratio %.2f\n", c, l / c);
    std::printf("  rows reach the view %.1f ms after the loop%s\n", Median(flushes),
                million ? " (target <= 50 ms)" : "");
    std::printf("  peak memory of the load %.1f MB for %.1f MB of shown columns: %.2fx%s\n",
                peak / 1e6, shown / 1e6, peak / shown, million ? " (target <= 1.5x)" : "");
    std::printf("  double-click report open, median of 21 rows: %.2f ms%s\n", Median(opens),
                million ? " (target <= 50 ms)" : "");
    std::fflush(stdout);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc > 2 && std::string(argv[1]) == "--load") {
        return MeasureOneLoad(argc, argv, argv[2]);
    }
    const int runs = argc > 1 ? std::atoi(argv[1]) : 5;
    const fs::path folder =
        argc > 2 ? fs::path(argv[2]) : fs::temp_directory_path() / "orbelane-bench";
    if (argc > 3) {
        MeasureStore(folder, {"invented", std::stoul(argv[3]), 0}, runs);
        return 0;
    }
    for (const Shape& shape : {Shape{"invented", 100000, 0}, Shape{"invented", 1000000, 0},
                               Shape{"30 bars a block", 1000000, 30}}) {
        MeasureStore(folder, shape, runs);
    }
    return 0;
}
