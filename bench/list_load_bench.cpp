// The list load and the report open on big stores, with the figures a person sees. For each
// store it times, in one run: the first row painted, from the start of the real program's
// process; the longest time between two repaints of the window while the list loads; the load,
// from PagePanel1.Value = 1 to the end of its loop, against two yardsticks on the same file: the
// floor, a loop in this process that prepares the list query and asks SQLite for the text of
// every column of every row, and `sqlite3 FILE "select * from results_store"`; and the peak
// memory of a load against the bytes of the shown columns. It also prints the time for the rows
// to reach the view, the double-click open, how often the window was brought up to date during
// the load and during a copy of a 2,000-file tree, and the load against one whose yield is empty.
// With --against, another build of this benchmark runs its loads in the same rounds, and the
// figures of both stand side by side.
//
//   bench_list_load [RUNS] [FOLDER] [COUNT] [--against OTHER_BENCH]
//       (stores are made in FOLDER once and kept; with COUNT, one store of COUNT invented
//        results only)
//   bench_list_load --load ROOT [empty]   (one measured load in this process)
//   bench_list_load --start ROOT          (the program's start-up until its first row is
//                                          painted; both used by the above)
#include <QApplication>
#include <QElapsedTimer>
#include <QTimer>

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <sqlite3.h>

#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <fstream>
#include <string>
#include <vector>

#include "installer/copy.h"
#include "platform/runtime/runtime.h"
#include "platform/runtime/yield.h"
#include "platform/widgets/list_model.h"
#include "shell/startup.h"
#include "shell/window1.h"
#include "demo/demo_tree.h"
#include "timing.h"

extern char** environ;

namespace fs = std::filesystem;

namespace {

constexpr int kCopyFiles = 2000;

// The monotonic clock, which every process on the machine shares, in milliseconds.
double ClockMilliseconds() {
    return std::chrono::duration<double, std::milli>(
               std::chrono::steady_clock::now().time_since_epoch())
        .count();
}

double ThreadCpuMilliseconds() {
    timespec now{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &now);
    return static_cast<double>(now.tv_sec) * 1e3 + static_cast<double>(now.tv_nsec) / 1e6;
}

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
// copy copyPaints painting gap cpu" (ms, ms, bytes, bytes, ms, count, ms, count, ms, count, ms,
// ms, ms). The gap is the longest time without a repaint, from the arrival on the list page
// until the rows have reached the view; cpu is the processor time of the load, which holds
// steadier than its wall time when other work shares the machine.
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
    double lastPaint = 0;
    double gap = 0;
    SetYieldPaintObserverForTesting([&](std::chrono::nanoseconds spent) {
        ++paints;
        painting += std::chrono::duration<double, std::milli>(spent).count();
        const double now = timer.nsecsElapsed() / 1e6;
        gap = std::max(gap, now - lastPaint);
        lastPaint = now;
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
    const double cpuBefore = ThreadCpuMilliseconds();
    timer.start();
    window->PagePanel1()->SetValue(1);
    const double load = timer.nsecsElapsed() / 1e6;
    const double cpu = ThreadCpuMilliseconds() - cpuBefore;
    const int loadPaints = paints;
    const double loadPainting = painting;
    QElapsedTimer flushTimer;
    flushTimer.start();
    QCoreApplication::processEvents();  // the rows reach the view, which is painted
    const double flush = flushTimer.nsecsElapsed() / 1e6;
    gap = std::max(gap, timer.nsecsElapsed() / 1e6 - lastPaint);
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
    std::printf("%.2f %.2f %ld %zu %.3f %lld %.2f %d %.2f %d %.2f %.2f %.2f\n", load, flush,
                peak * 1024, shown, Median(opens), list->ListCount(), firstRows, loadPaints, copy,
                copyPaints, loadPainting, gap, cpu);
    std::fflush(stdout);
    std::_Exit(0);
}

// The real program's start-up, until a yield has painted the list with rows in it: prints the
// clock at that moment, for the parent to set against the moment it started the process.
int MeasureStart(int argc, char** argv, const char* root) {
    setenv("ORBELANE_ROOT", root, 1);
    RuntimeInit(argc, argv);
    RuntimePerformInitializers();
    SetYieldPaintObserverForTesting([](std::chrono::nanoseconds) {
        auto window = Cast<class Window1>(_GetImplicitWindow("Window1.Window1"));
        if (window && window->Listbox1()->Model().rowCount() > 0) {
            std::printf("%.3f\n", ClockMilliseconds());
            std::fflush(stdout);
            std::_Exit(0);
        }
    });
    QTimer::singleShot(0, [] { QTimer::singleShot(10000, [] { std::_Exit(1); }); });
    _Main();
    return 1;
}

// Runs a program with its standard output in a pipe: gives the output, and in `started` the
// clock just before the process was made.
std::string RunChild(const std::vector<std::string>& arguments, double& started) {
    int pipeEnds[2];
    if (pipe(pipeEnds) != 0) {
        return {};
    }
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, pipeEnds[1], STDOUT_FILENO);
    posix_spawn_file_actions_addclose(&actions, pipeEnds[0]);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
    std::vector<char*> argv;
    for (const std::string& argument : arguments) {
        argv.push_back(const_cast<char*>(argument.c_str()));
    }
    argv.push_back(nullptr);
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    pid_t pid = 0;
    started = ClockMilliseconds();
    const int spawned = posix_spawn(&pid, argv[0], &actions, nullptr, argv.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    close(pipeEnds[1]);
    std::string output;
    char buffer[4096];
    for (ssize_t got; (got = read(pipeEnds[0], buffer, sizeof buffer)) > 0;) {
        output.append(buffer, static_cast<size_t>(got));
    }
    close(pipeEnds[0]);
    if (spawned == 0) {
        int status = 0;
        waitpid(pid, &status, 0);
    }
    return output;
}

// The floor: SQLite handing over every column of every row as text, nothing done with it. Gives
// its wall time, and its processor time in `cpu`.
double FloorMilliseconds(const fs::path& store, double& cpu) {
    size_t bytes = 0;
    const double cpuBefore = ThreadCpuMilliseconds();
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
    cpu = ThreadCpuMilliseconds() - cpuBefore;
    if (bytes == 0) {
        std::fprintf(stderr, "the floor read nothing\n");
    }
    return milliseconds;
}

struct ChildLoad {
    double load = 0, flush = 0, open = 0, firstRows = 0, copy = 0, painting = 0, gap = 0, cpu = 0;
    double peak = 0, shown = 0;
    int loadPaints = 0, copyPaints = 0;
};

ChildLoad RunChildLoad(const std::string& program, const fs::path& root, size_t count,
                       bool emptyYield) {
    std::vector<std::string> arguments = {program, "--load", root.string()};
    if (emptyYield) {
        arguments.push_back("empty");
    }
    double started = 0;
    const std::string output = RunChild(arguments, started);
    ChildLoad result;
    long long rows = 0;
    if (std::sscanf(output.c_str(), "%lf %lf %lf %lf %lf %lld %lf %d %lf %d %lf %lf %lf",
                    &result.load, &result.flush, &result.peak, &result.shown, &result.open, &rows,
                    &result.firstRows, &result.loadPaints, &result.copy, &result.copyPaints,
                    &result.painting, &result.gap, &result.cpu) != 13 ||
        rows != static_cast<long long>(count)) {
        std::fprintf(stderr, "the load of %s did not report\n", program.c_str());
    }
    return result;
}

// Milliseconds from the start of the process to its first row painted.
double RunChildStart(const std::string& program, const fs::path& root) {
    double started = 0;
    const std::string output = RunChild({program, "--start", root.string()}, started);
    double painted = 0;
    if (std::sscanf(output.c_str(), "%lf", &painted) != 1) {
        std::fprintf(stderr, "the start of %s did not report\n", program.c_str());
    }
    return painted - started;
}

struct Shape {
    const char* name;
    size_t count;
    int bars;  // 0: 12 to 19 bars, as invented
};

// The four figures a person sees, for one build, one value a round.
struct Seen {
    std::vector<double> firstRow, gap, load, cpu, loadToFloor, cpuToFloor, peakToShown;

    void Add(double start, const ChildLoad& child, double floor, double floorCpu) {
        firstRow.push_back(start);
        gap.push_back(child.gap);
        load.push_back(child.load);
        cpu.push_back(child.cpu);
        loadToFloor.push_back(child.load / floor);
        cpuToFloor.push_back(child.cpu / floorCpu);
        peakToShown.push_back(child.peak / child.shown);
    }
};

void PrintSideBySide(const Seen& self, const Seen& other, bool million) {
    const auto row = [&](const char* name, const std::vector<double>& a,
                         const std::vector<double>& b, const char* target) {
        std::printf("  %-34s %10.2f %10.2f %8.3f %s\n", name, Median(a), Median(b),
                    MedianOfRatios(a, b), million ? target : "");
    };
    std::printf("  %-34s %10s %10s %8s\n", "", "this", "other", "ratio");
    row("first row painted, ms from start", self.firstRow, other.firstRow, "(target <= 100)");
    row("longest gap between repaints, ms", self.gap, other.gap, "(target <= 200)");
    row("list load, ms", self.load, other.load, "");
    row("list load, processor ms", self.cpu, other.cpu, "");
    row("list load / floor", self.loadToFloor, other.loadToFloor, "(target <= 1.5)");
    row("list load / floor, processor time", self.cpuToFloor, other.cpuToFloor, "");
    row("peak memory / shown bytes", self.peakToShown, other.peakToShown, "(target <= 1.6)");
}

void MeasureStore(const fs::path& folder, const Shape& shape, int runs, const std::string& other) {
    const std::string self = fs::canonical("/proc/self/exe").string();
    const fs::path root = folder / (std::to_string(shape.count) +
                                    (shape.bars ? "-bars" + std::to_string(shape.bars) : ""));
    const fs::path store = demo::StorePath(root);
    if (!fs::exists(store)) {
        std::printf("making a store of %zu results...\n", shape.count);
        std::fflush(stdout);
        demo::WriteInventedStore(store, shape.count, shape.bars);
    }
    std::vector<double> loads, floors, cli, flushes, opens, peaks, shownBytes;
    std::vector<double> emptyLoads, firstRows, loadRates, copyRates, copies, emptyCopies;
    std::vector<double> paintShares;
    Seen seen, seenOther;
    RunChildStart(self, root);  // warms the caches for both builds
    if (!other.empty()) {
        RunChildStart(other, root);
    }
    for (int i = 0; i < runs; ++i) {
        const double start = RunChildStart(self, root);
        const ChildLoad painting = RunChildLoad(self, root, shape.count, false);
        const ChildLoad empty = RunChildLoad(self, root, shape.count, true);
        double floorCpu = 0;
        floors.push_back(FloorMilliseconds(store, floorCpu));
        seen.Add(start, painting, floors.back(), floorCpu);
        if (!other.empty()) {
            const double otherStart = RunChildStart(other, root);
            seenOther.Add(otherStart, RunChildLoad(other, root, shape.count, false), floors.back(),
                          floorCpu);
        }
        loads.push_back(painting.load);
        flushes.push_back(painting.flush);
        opens.push_back(painting.open);
        peaks.push_back(painting.peak);
        shownBytes.push_back(painting.shown);
        emptyLoads.push_back(empty.load);
        firstRows.push_back(painting.firstRows);
        loadRates.push_back(painting.loadPaints * 1000.0 / painting.load);
        copyRates.push_back(painting.copyPaints * 1000.0 / painting.copy);
        copies.push_back(painting.copy);
        paintShares.push_back(painting.painting / painting.load);
        emptyCopies.push_back(empty.copy);
        cli.push_back(TimeCommand("sqlite3 '" + store.string() +
                                  "' \"select * from results_store\" > /dev/null"));
    }
    const bool million = shape.count >= 1000000;
    const double l = Median(loads);
    const double f = Median(floors);
    const double c = Median(cli);
    const double peak = Median(peaks);
    const double shown = Median(shownBytes);
    const double average = static_cast<double>(fs::file_size(store)) / shape.count;
    std::printf("%zu results, %s (%.0f bytes a row on file), median of %d:\n", shape.count,
                shape.name, average, runs);
    std::printf("  first row painted %.1f ms after the process started%s\n", Median(seen.firstRow),
                million ? " (target <= 100 ms)" : "");
    std::printf("  longest time between two repaints during the load %.1f ms%s\n", Median(seen.gap),
                million ? " (target <= 200 ms)" : "");
    std::printf(
        "  list load %.0f ms, floor %.0f ms: ratio %.2f, median of the paired ratios "
        "%.2f%s\n",
        l, f, l / f, MedianOfRatios(loads, floors), million ? " (target <= 1.5)" : "");
    std::printf("  sqlite3 CLI %.0f ms: ratio %.2f\n", c, l / c);
    std::printf("  peak memory of the load %.1f MB for %.1f MB of shown columns: %.2fx%s\n",
                peak / 1e6, shown / 1e6, peak / shown, million ? " (target <= 1.6x)" : "");
    std::printf("  rows reach the view %.1f ms after the loop\n", Median(flushes));
    std::printf("  double-click report open, median of 21 rows: %.2f ms\n", Median(opens));
    std::printf("  first rows painted %.1f ms after the arrival on the list page\n",
                Median(firstRows));
    std::printf(
        "  window brought up to date %.1f times a second during the load, %.1f during a copy of "
        "%d files\n",
        Median(loadRates), Median(copyRates), kCopyFiles);
    const double e = Median(emptyLoads);
    std::printf(
        "  load %.0f ms against %.0f ms with an empty yield: ratio %.3f; copy %.0f ms against "
        "%.0f ms: ratio %.2f\n",
        l, e, l / e, Median(copies), Median(emptyCopies), Median(copies) / Median(emptyCopies));
    std::printf("  painting took %.1f%% of the load, measured inside the yield\n",
                100 * Median(paintShares));
    if (!other.empty()) {
        std::printf("  side by side with %s, ratio = median of this / other per round:\n",
                    other.c_str());
        PrintSideBySide(seen, seenOther, million);
    }
    std::fflush(stdout);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc > 2 && std::string(argv[1]) == "--load") {
        return MeasureOneLoad(argc, argv, argv[2], argc > 3 && std::string(argv[3]) == "empty");
    }
    if (argc > 2 && std::string(argv[1]) == "--start") {
        return MeasureStart(argc, argv, argv[2]);
    }
    std::vector<std::string> positional;
    std::string other;
    for (int i = 1; i < argc; ++i) {
        if (std::string(argv[i]) == "--against" && i + 1 < argc) {
            other = fs::canonical(argv[++i]).string();
        } else {
            positional.emplace_back(argv[i]);
        }
    }
    const int runs = positional.size() > 0 ? std::stoi(positional[0]) : 5;
    const fs::path folder = positional.size() > 1 ? fs::path(positional[1])
                                                  : fs::temp_directory_path() / "orbelane-bench";
    if (positional.size() > 2) {
        MeasureStore(folder, {"invented", std::stoul(positional[2]), 0}, runs, other);
        return 0;
    }
    for (const Shape& shape : {Shape{"invented", 100000, 0}, Shape{"invented", 1000000, 0},
                               Shape{"30 bars a block", 1000000, 30}}) {
        MeasureStore(folder, shape, runs, other);
    }
    return 0;
}
