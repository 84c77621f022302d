// The run-time's exception classes and the two exception-handling calls.
#pragma once

#include <exception>
#include <functional>
#include <memory>
#include <string>

class RuntimeException : public std::exception {
  public:
    explicit RuntimeException(std::string message = {}) : Message(std::move(message)) {}
    virtual std::string ClassName() const { return "RuntimeException"; }
    const char* what() const noexcept override { return Message.c_str(); }

    long long ErrorNumber = 0;
    std::string Message;
};

// Each subclass names itself, so that the last resort can say which class reached it.
class NilObjectException : public RuntimeException {
  public:
    using RuntimeException::RuntimeException;
    std::string ClassName() const override { return "NilObjectException"; }
};
class IllegalCastException : public RuntimeException {
  public:
    using RuntimeException::RuntimeException;
    std::string ClassName() const override { return "IllegalCastException"; }
};
class OutOfBoundsException : public RuntimeException {
  public:
    using RuntimeException::RuntimeException;
    std::string ClassName() const override { return "OutOfBoundsException"; }
};
class StackOverflowException : public RuntimeException {
  public:
    using RuntimeException::RuntimeException;
    std::string ClassName() const override { return "StackOverflowException"; }
};
class ThreadAccessingUIException : public RuntimeException {
  public:
    using RuntimeException::RuntimeException;
    std::string ClassName() const override { return "ThreadAccessingUIException"; }
};
// A file-system operation that failed in a way that a later look at the disk would not show.
class IOException : public RuntimeException {
  public:
    using RuntimeException::RuntimeException;
    std::string ClassName() const override { return "IOException"; }
};
class EndException : public RuntimeException {
  public:
    using RuntimeException::RuntimeException;
    std::string ClassName() const override { return "EndException"; }
};
class ThreadEndException : public RuntimeException {
  public:
    using RuntimeException::RuntimeException;
    std::string ClassName() const override { return "ThreadEndException"; }
};

// The global exception helper that _Main installs: runs `function(argument)` and hands back the
// RuntimeException that left it, itself and not a copy, or nullptr. It catches every
// RuntimeException alike and decides nothing; anything else goes on up. Not to be confused with
// Application::_CallFunctionWithExceptionHandling, which runs event handlers and itself decides
// what an exception leads to.
std::shared_ptr<RuntimeException> _CallFunctionWithExceptionHandling(
    const std::function<void(void*)>& function, void* argument);

// The platform's last resort for an exception that reached the top: one line naming the
// exception's class on stderr, and the program goes on.
void _UnhandledException(const RuntimeException& exception);
