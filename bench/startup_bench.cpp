// Times process start to the window shown on the list page (to the first rows painted, on a
// store with results), against a minimal Qt program that shows one window, alternating the two
// in one run. Prints both medians and their ratio.
#include <spawn.h>
#include <sys/wait.h>

#include <cstdio>
#include <string>
#include <vector>

#include "timing.h"

extern char** environ;

namespace {

double RunMilliseconds(const std::string& program, const char* argument = nullptr) {
    return Milliseconds([&] {
        pid_t pid = 0;
        char* argv[] = {const_cast<char*>(program.c_str()), const_cast<char*>(argument), nullptr};
        if (posix_spawn(&pid, program.c_str(), nullptr, nullptr, argv, environ) != 0) {
            std::perror("posix_spawn");
            return;
        }
        int status = 0;
        waitpid(pid, &status, 0);
        if (!WIFEXITED(status) || WEXITSTATUS(status) != 0) {
            std::fprintf(stderr, "%s did not show its window\n", program.c_str());
        }
    });
}

}  // namespace

int main(int argc, char** argv) {
    const std::string folder = std::string(argv[0]).substr(0, std::string(argv[0]).rfind('/') + 1);
    const int runs = argc > 1 ? std::atoi(argv[1]) : 21;
    std::vector<double> program;
    std::vector<double> minimal;
    std::vector<double> withText;
    RunMilliseconds(folder + "bench_startup_app");  // warm the caches for both
    RunMilliseconds(folder + "bench_minimal_app");
    for (int i = 0; i < runs; ++i) {
        program.push_back(RunMilliseconds(folder + "bench_startup_app"));
        minimal.push_back(RunMilliseconds(folder + "bench_minimal_app"));
        withText.push_back(RunMilliseconds(folder + "bench_minimal_app", "text"));
    }
    const double p = Median(program);
    const double m = Median(minimal);
    std::printf(
        "start to window on list page, median of %d: program %.1f ms, minimal Qt %.1f ms, "
        "ratio %.2f\n",
        runs, p, m, p / m);
    const double t = Median(withText);
    std::printf(
        "against a minimal Qt window with one line of text: %.1f ms, ratio %.2f, median of the "
        "paired ratios %.2f (target <= 1.3)\n",
        t, p / t, MedianOfRatios(program, withText));
    return 0;
}
