// Exception helpers of the run-time: the global helper and the last resort.
#include "platform/core/exceptions.h"

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
