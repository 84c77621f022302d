#!/usr/bin/env bash
# Builds the tests with AddressSanitizer and UndefinedBehaviorSanitizer in their own build
# folder and runs them; any report fails the run. Only the test targets and the program that
# one of them starts are built, at -O1, to keep the step short.
set -euo pipefail
cd "$(dirname "$0")/.."
# Also for the test discovery that runs the instrumented binary at build time.
export ASAN_OPTIONS="abort_on_error=0:halt_on_error=1:detect_leaks=1:detect_stack_use_after_return=0"
export LSAN_OPTIONS="suppressions=$PWD/tests/sanitizer/lsan.supp:print_suppressions=0"
export UBSAN_OPTIONS="halt_on_error=1:print_stacktrace=1"
cmake -S . -B build-sanitize -DCMAKE_BUILD_TYPE=Debug -DCMAKE_CXX_FLAGS_DEBUG="-g -O1" \
  -DORBELANE_SANITIZE=ON -DORBELANE_BENCH=OFF
cmake --build build-sanitize -j"$(nproc)" --target orbelane_tests orbelane_portal_tests
QT_QPA_PLATFORM=offscreen ctest --test-dir build-sanitize --output-on-failure -j"$(nproc)"
