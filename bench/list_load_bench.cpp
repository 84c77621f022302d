// The list load and the report open on big stores. For each store it times, in one run, the
// load from PagePanel1.Value = 1 to the end of its loop against two yardsticks on the same
// file: the floor, a loop in this process that prepares the list query and asks SQLite for the
// text of every column of every row, and `sqlite3 FILE "select * from results_store"`. It
// reports the peak memory of a load against the bytes of the shown columns, the time for the
// rows to reach the view, and the double-click open. Loads with the painting yield alternate
// with loads whose yield is empty: it prints when the first rows were painted after the arrival
// on the list page, how often the window was brought up to date during the load and during a
// copy of a 2,000-file tree, and the painting load against the empty one.
//
//   bench_list_load [RUNS] [FOLDER] [COUNT]  (stores are made in FOLDER once and kept; with
//                                             COUNT, one store of COUNT invented results only)
//   bench_list_load --load ROOT [empty]      (one measured load in this process; used by the
//                                             above)
#include <QApplication>
#include <QElapsedTimer>

#include <unistd.h>

#include <sqlite3.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>
#include <vector>

#include "installer/copy.h"
#include "platform/runtime/runtime.h"
#include "platform/runtime/yield.h"
#include "shell/startup.h"
#include "shell/window1.h"
#include "demo/demo_tree.h"
#include "timing.h"

namespace fs = std::filesystem;

namespace {

constexpr int kCopyFiles = 2000;

// The copy's source: 20 folders of 100 files of 10 KB, made once beside the store.
fs::path CopySource(const fs::path& root) {
    const fs::path source = root / "copy-source" / "Ostrelin.acroplugin";
    if (!fs::exists(source)) {
        const std::string bytes(10 * 1024, 'p');
        for (int i = 0; i < kCopyFiles; ++i) {
            const fs::path folder = source / ("group" + std::to_string(i / 100));
            fs::create_directories(folder);
            std::ofstream(folder / ("file" + std::to_string(i) + ".bin"), std::ios::binary)
                << bytes;
        }
    }
    return source;
}

// The copy with the window on screen: its time and the yields that painted.
std::pair<double, int> MeasureCopy(const fs::path& root, int& paints) {
    const fs::path target = root / ("copy-target-" + std::to_string(getpid()));
    fs::create_directories(target);
    const fs::path source = CopySource(root);
    const int before = paints;
    const double milliseconds = Milliseconds([&] {
        CopyFileOrFolder(GetFolderItem(source.string(), 3), GetFolderItem(target.string(), 3));
    });
    fs::remove_all(target);
    return {milliseconds, paints - before};
}

// One load in a fresh process: prints "load flush peak shown open rows firstRows loadPaints
// copy copyPaints painting" (ms, ms, bytes, bytes, ms, count, ms, count, ms, count, ms).
int MeasureOneLoad(int argc, char** argv, const char* root, bool emptyYield) {
    setenv("ORBELANE_ROOT", root, 1);
    RuntimeInit(argc, argv);
    _EarlyStartup();
    auto window = Window1();
    QCoreApplication::processEvents();
    if (emptyYield) {
        SetYieldIntervalForTesting(std::chrono::nanoseconds::max());
    }
    QElapsedTimer timer;
    double firstRows = -1;
    int paints = 0;
    double painting = 0;  // ms inside the yields that painted, during the load
    SetYieldPaintObserverForTesting([&](std::chrono::nanoseconds spent) {
        ++paints;
        painting += std::chrono::duration<double, std::milli>(spent).count();
    });
    auto cellPaint = window->Listbox1()->CellBackgroundPaint;
    window->Listbox1()->CellBackgroundPaint = [&](Listbox& list, Ref<Graphics> g, long long row,
                                                  long long column) {
        if (firstRows < 0 && YieldIsPainting()) {
            firstRows = timer.nsecsElapsed() / 1e6;
        }
        return cellPaint(list, g, row, column);
    };
    const long baseline = StatusKilobytes("VmRSS");
    timer.start();
    window->PagePanel1()->SetValue(1);
    const double load = timer.nsecsElapsed() / 1e6;
    const int loadPaints = paints;
    const double loadPainting = painting;
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
    const auto [copy, copyPaints] = MeasureCopy(root, paints);
    std::printf("%.2f %.2f %ld %zu %.3f %lld %.2f %d %.2f %d %.2f\n", load, flush, peak * 1024,
                shown, Median(opens), list->ListCount(), firstRows, loadPaints, copy, copyPaints,
                loadPainting);
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

struct ChildLoad {
    double load = 0, flush = 0, open = 0, firstRows = 0, copy = 0, painting = 0;
    int loadPaints = 0, copyPaints = 0;
};

ChildLoad RunChildLoad(const std::string& self, const fs::path& root, size_t count, bool emptyYield,
                       double& peak, double& shown) {
    const std::string command = "QT_QPA_PLATFORM=offscreen '" + self + "' --load '" +
                                root.string() + "'" + (emptyYield ? " empty" : "") + " 2>/dev/null";
    FILE* child = popen(command.c_str(), "r");
    ChildLoad result;
    long long rows = 0;
    if (std::fscanf(child, "%lf %lf %lf %lf %lf %lld %lf %d %lf %d %lf", &result.load,
                    &result.flush, &peak, &shown, &result.open, &rows, &result.firstRows,
                    &result.loadPaints, &result.copy, &result.copyPaints, &result.painting) != 11 ||
        rows != static_cast<long long>(count)) {
        std::fprintf(stderr, "the load did not report\n");
    }
    pclose(child);
    return result;
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
    std::vector<double> emptyLoads, firstRows, loadRates, copyRates, copies, emptyCopies;
    std::vector<double> paintShares;
    double peak = 0, shown = 0;
    for (int i = 0; i < runs; ++i) {
        const ChildLoad painting = RunChildLoad(self, root, shape.count, false, peak, shown);
        const ChildLoad empty = RunChildLoad(self, root, shape.count, true, peak, shown);
        loads.push_back(painting.load);
        flushes.push_back(painting.flush);
        opens.push_back(painting.open);
        emptyLoads.push_back(empty.load);
        firstRows.push_back(painting.firstRows);
        loadRates.push_back(painting.loadPaints * 1000.0 / painting.load);
        copyRates.push_back(painting.copyPaints * 1000.0 / painting.copy);
        copies.push_back(painting.copy);
        paintShares.push_back(painting.painting / painting.load);
        emptyCopies.push_back(empty.copy);
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
    std::printf(
        "  list load %.0f ms, floor %.0f ms: ratio %.2f, median of the paired ratios "
        "%.2f%s\n",
        l, f, l / f, MedianOfRatios(loads, floors), million ? " (target <= 1.5)" : "");
    std::printf("  sqlite3 CLI %.0f ms: ratio %.2f\n", c, l / c);
    std::printf("  rows reach the view %.1f ms after the loop%s\n", Median(flushes),
                million ? " (target <= 50 ms)" : "");
    std::printf("  peak memory of the load %.1f MB for %.1f MB of shown columns: %.2fx%s\n",
                peak / 1e6, shown / 1e6, peak / shown, million ? " (target <= 1.5x)" : "");
    std::printf("  double-click report open, median of 21 rows: %.2f ms%s\n", Median(opens),
                million ? " (target <= 50 ms)" : "");
    const double e = Median(emptyLoads);
    std::printf(
        "  painting yield: first rows painted %.1f ms after the arrival (target <= 100 ms)\n",
        Median(firstRows));
    std::printf(
        "  window brought up to date %.1f times a second during the load, %.1f during a copy of "
        "%d files (target >= 10)\n",
        Median(loadRates), Median(copyRates), kCopyFiles);
    std::printf(
        "  load %.0f ms against %.0f ms with an empty yield: ratio %.3f (target <= 1.05); copy "
        "%.0f ms against %.0f ms: ratio %.2f\n",
        l, e, l / e, Median(copies), Median(emptyCopies), Median(copies) / Median(emptyCopies));
    std::printf("  painting took %.1f%% of the load, measured inside the yield\n",
                100 * Median(paintShares));
    std::fflush(stdout);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc > 2 && std::string(argv[1]) == "--load") {
        return MeasureOneLoad(argc, argv, argv[2], argc > 3 && std::string(argv[3]) == "empty");
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
