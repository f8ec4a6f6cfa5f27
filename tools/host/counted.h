#pragma once

#include <utility>

namespace dp::tool {

// Owns one reference to an object of the library.
template <class T>
class Counted {
  public:
    explicit Counted(T* object = nullptr) : object_(object) {
        if (object_ != nullptr) object_->AddRef();
    }
    Counted(Counted&& other) noexcept : object_(std::exchange(other.object_, nullptr)) {}
    Counted& operator=(Counted&& other) noexcept {
        std::swap(object_, other.object_);
        return *this;
    }
    ~Counted() {
        if (object_ != nullptr) object_->Release();
    }

    T* get() const { return object_; }
    T* operator->() const { return object_; }
    T& operator*() const { return *object_; }

  private:
    T* object_;
};

}  // namespace dp::tool
