// Exception helpers of the run-time: the global helper, the last resort and the stack check.
#include "platform/exceptions.h"

#include <cstdio>

std::shared_ptr<RuntimeException> _CallFunctionWithExceptionHandling(
    const std::function<void(void*)>& function, void* argument) {
    try {
        function(argument);
        return nullptr;
    } catch (RuntimeException& e) {
        // The result shares ownership of the thrown object, so it keeps its class: the last
        // resort names it, and an EndException is still one.
        auto thrown = std::make_shared<std::exception_ptr>(std::current_exception());
        return std::shared_ptr<RuntimeException>(thrown, &e);
    }
}

void _UnhandledException(const RuntimeException& exception) {
    std::fprintf(stderr, "Unhandled %s\n", exception.ClassName().c_str());
    std::fflush(stderr);
}

namespace {
int depth = 0;
}

// A depth limit stands in for the stack test: 32 levels is deeper than any plug-in bundle
// and below the 40 symbolic links that the kernel resolves in one path, so a link that
// points back up the tree ends here rather than in a file error.
StackCheck::StackCheck() {
    if (depth >= kMaxDepth) {
        throw StackOverflowException("Stack overflow");
    }
    ++depth;
}

StackCheck::~StackCheck() {
    --depth;
}
