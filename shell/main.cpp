// The entry point: the run-time around _Main.
#include "platform/runtime/runtime.h"
#include "shell/startup.h"

int main(int argc, char** argv) {
    RuntimeInit(argc, argv);
    RuntimePerformInitializers();
    _Main();
    RuntimePerformFinalizers();
    return RuntimeExit();
}
