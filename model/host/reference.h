#pragma once

#include <cstddef>
#include <utility>

namespace dp {

// Holds one reference to a counted object (a provider, worksheet or column) and gives it back in
// the end, which deletes the object when nobody else holds one:
//
//     IColumn* loaded = nullptr;
//     if (!finder.FindColumn(key, &loaded, false)) return;
//     const Reference<IColumn> column(loaded);
//
// Like a plain pointer it may be null, and like the counts it is not safe from two threads. The
// library must stay loaded while one exists.
template <class T>
class Reference {
  public:
    Reference() = default;
    // Takes a reference to `object`, which may be null. What a query returns has a count of 0, so
    // this makes the reference its first.
    explicit Reference(T* object) : object_(object) {
        if (object_ != nullptr) object_->AddRef();
    }
    Reference(const Reference& other) : Reference(other.object_) {}
    // A reference that was moved from is null.
    Reference(Reference&& other) noexcept : object_(std::exchange(other.object_, nullptr)) {}
    // Takes the new reference before the old one is given back: both may be to one object.
    Reference& operator=(Reference other) noexcept {
        std::swap(object_, other.object_);
        return *this;
    }
    ~Reference() {
        if (object_ != nullptr) object_->Release();
    }

    // Gives the reference back and takes one to `object` instead.
    void reset(T* object = nullptr) { *this = Reference(object); }

    // The object, null when there is none. Valid as long as something holds a reference to it.
    T* get() const { return object_; }
    // Not for a null reference.
    T* operator->() const { return object_; }
    T& operator*() const { return *object_; }

  private:
    T* object_ = nullptr;
};

template <class T>
bool operator==(const Reference<T>& reference, std::nullptr_t) {
    return reference.get() == nullptr;
}

template <class T>
bool operator!=(const Reference<T>& reference, std::nullptr_t) {
    return reference.get() != nullptr;
}

}  // namespace dp
