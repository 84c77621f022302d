// Ref<T>: the nullable, reference-counted object reference of the run-time. Using an empty
// Ref raises NilObjectException instead of crashing.
#pragma once

#include <memory>
#include <typeinfo>
#include <utility>

#include "platform/core/exceptions.h"

template <class T>
class Ref {
  public:
    Ref() = default;
    Ref(std::nullptr_t) {}
    Ref(std::shared_ptr<T> object) : object_(std::move(object)) {}
    template <class U>
    Ref(const Ref<U>& other) : object_(other.Shared()) {}

    T* operator->() const { return &Get(); }
    T& operator*() const { return Get(); }
    T& Get() const {
        if (!object_) {
            throw NilObjectException("Nil object");
        }
        return *object_;
    }

    bool IsNil() const { return !object_; }
    explicit operator bool() const { return static_cast<bool>(object_); }
    const std::shared_ptr<T>& Shared() const { return object_; }

    friend bool operator==(const Ref& a, const Ref& b) { return a.object_ == b.object_; }
    friend bool operator==(const Ref& a, std::nullptr_t) { return !a.object_; }

  private:
    std::shared_ptr<T> object_;
};

template <class T, class... Args>
Ref<T> New(Args&&... args) {
    return Ref<T>(std::make_shared<T>(std::forward<Args>(args)...));
}

// A cast that the run-time tests: Nil stays Nil, an object of another class raises.
template <class T, class U>
Ref<T> Cast(const Ref<U>& from) {
    if (from.IsNil()) {
        return nullptr;
    }
    if (typeid(*from.Shared()) == typeid(T)) {  // the common case, without the search
        return Ref<T>(std::static_pointer_cast<T>(from.Shared()));
    }
    auto to = std::dynamic_pointer_cast<T>(from.Shared());
    if (!to) {
        throw IllegalCastException("Illegal cast");
    }
    return Ref<T>(to);
}
