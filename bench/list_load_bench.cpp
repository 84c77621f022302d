// The list load and the report open on big stores. For 100,000 and 1,000,000 results it times,
// in one run, the load from PagePanel1.Value = 1 to the end of its loop against
// `sqlite3 FILE "select * from results_store" > /dev/null` on the same file, and reports the
// peak memory of a load against the bytes of the shown columns, and the double-click open.
//
//   bench_list_load [RUNS] [FOLDER]    (stores are made in FOLDER once and kept)
//   bench_list_load --load ROOT        (one measured load in this process; used by the above)
#include <QApplication>
#include <QElapsedTimer>

#include <algorithm>
#include <chrono>
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

}  // namespace

int main(int argc, char** argv) {
    if (argc > 2 && std::string(argv[1]) == "--load") {
        return MeasureOneLoad(argc, argv, argv[2]);
    }
    const int runs = argc > 1 ? std::atoi(argv[1]) : 5;
    const fs::path folder =
        argc > 2 ? fs::path(argv[2]) : fs::temp_directory_path() / "orbelane-bench";
    const std::string self = fs::canonical("/proc/self/exe").string();
    for (size_t count : {100000u, 1000000u}) {
        const fs::path root = folder / std::to_string(count);
        const fs::path store = demo::StorePath(root);
        if (!fs::exists(store)) {
            std::printf("making a store of %zu results...\n", count);
            std::fflush(stdout);
            demo::WriteInventedStore(store, count);
        }
        std::vector<double> loads, cli, flushes, opens;
        double peak = 0, shown = 0;
        for (int i = 0; i < runs; ++i) {
            const std::string command = "QT_QPA_PLATFORM=offscreen '" + self + "' --load '" +
                                        root.string() + "' 2>/dev/null";
            FILE* child = popen(command.c_str(), "r");
            double load = 0, flush = 0, open = 0;
            long long rows = 0;
            if (std::fscanf(child, "%lf %lf %lf %lf %lf %lld", &load, &flush, &peak, &shown, &open,
                            &rows) != 6 ||
                rows != static_cast<long long>(count)) {
                std::fprintf(stderr, "the load did not report\n");
            }
            pclose(child);
            loads.push_back(load);
            flushes.push_back(flush);
            opens.push_back(open);
            cli.push_back(TimeCommand("sqlite3 '" + store.string() +
                                      "' \"select * from results_store\" > /dev/null"));
        }
        const double l = Median(loads);
        const double c = Median(cli);
        std::printf(
            "%zu results, median of %d: list load %.0f ms (rows reach the view in %.0f "
            "ms more), sqlite3 CLI %.0f ms, ratio %.2f%s\n",
            count, runs, l, Median(flushes), c, l / c, count == 1000000 ? " (target <= 1.5)" : "");
        std::printf(
            "  peak memory of the load %.1f MB for %.1f MB of shown columns: %.2fx "
            "(target <= 2x)\n",
            peak / 1e6, shown / 1e6, peak / shown);
        std::printf("  double-click report open, median of 21 rows: %.2f ms%s\n", Median(opens),
                    count == 1000000 ? " (target <= 50 ms)" : "");
        std::fflush(stdout);
    }
    return 0;
}
