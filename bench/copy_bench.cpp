// CopyFileOrFolder of a 5,000-file, 50 MB plug-in tree against `cp -r` of the same tree, in
// one run, alternating; prints both medians and their ratio.
//
//   bench_copy [RUNS]
#include <QApplication>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "installer/copy.h"
#include "platform/runtime/runtime.h"
#include "timing.h"

namespace fs = std::filesystem;

namespace {

constexpr int kFiles = 5000;
constexpr int kFilesPerFolder = 100;
constexpr size_t kFileBytes = 10 * 1024;

void MakeTree(const fs::path& bundle) {
    const std::string bytes(kFileBytes, 'p');
    for (int i = 0; i < kFiles; ++i) {
        const fs::path folder = bundle / "Contents" / "Resources" /
                                ("group" + std::to_string(i / kFilesPerFolder)) /
                                (i % 2 ? "nested" : "");
        fs::create_directories(folder);
        std::ofstream(folder / ("file" + std::to_string(i) + ".bin"), std::ios::binary) << bytes;
    }
}

}  // namespace

int main(int argc, char** argv) {
    const int runs = argc > 1 ? std::atoi(argv[1]) : 7;
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    RuntimeInit(argc, argv);

    std::string pattern = (fs::temp_directory_path() / "orbelane-copy-XXXXXX").string();
    const fs::path work = mkdtemp(pattern.data());
    const fs::path source = work / "Ostrelin.acroplugin";
    MakeTree(source);
    std::vector<double> ours, cp;
    for (int i = 0; i < runs; ++i) {
        const fs::path a = work / ("ours" + std::to_string(i));
        const fs::path b = work / ("cp" + std::to_string(i));
        fs::create_directories(a);
        fs::create_directories(b);
        std::system("sync");
        ours.push_back(Milliseconds([&] {
            CopyFileOrFolder(GetFolderItem(source.string(), 3), GetFolderItem(a.string(), 3));
        }));
        std::system("sync");
        cp.push_back(TimeCommand("cp -r '" + source.string() + "' '" + b.string() + "/'"));
        fs::remove_all(a);
        fs::remove_all(b);
    }
    const double o = Median(ours);
    const double c = Median(cp);
    std::printf(
        "copy of %d files, %zu MB, median of %d: CopyFileOrFolder %.0f ms, cp -r %.0f ms, "
        "ratio %.2f (target <= 1.2)\n",
        kFiles, kFiles * kFileBytes / (1024 * 1024), runs, o, c, o / c);
    fs::remove_all(work);
    std::fflush(stdout);
    std::_Exit(0);
}
