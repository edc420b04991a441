#pragma once

#include <cassert>
#include <cstddef>
#include <cstdint>
#include <type_traits>
#include <utility>
#ifndef NDEBUG
#include <thread>
#endif

#include "platform/runtime/Name.h"

namespace tavro {

class Class;
class id;
struct ObjectExtras;
struct WeakSlot;

/// The base of everything that receives messages. An object is created and used on one thread, so
/// its count is a plain integer (a debug build asserts the thread); only class objects may be
/// messaged from any thread. Constructors send no messages: the class is set right after them.
class Object {
 public:
  Object(const Object&) = delete;
  Object& operator=(const Object&) = delete;

  /// The class that answers messages to this object. A class object's class is its metaclass.
  [[nodiscard]] Class* isa() const { return isa_; }
  /// Used once by allocation.
  void becomeInstanceOf(Class* isa) { isa_ = isa; }

  void retain() {
    assertOwner();
    ++count_;
  }
  void release() {
    assertOwner();
    if (--count_ == 0) {
      destroy();
    }
  }
  [[nodiscard]] std::uint32_t referenceCount() const { return count_; }

  /// The value kept on this object under `key` (a name's hash or an address), or nil.
  [[nodiscard]] Object* attachedValue(std::uint64_t key) const;
  /// Keeps a strong reference to `value` under `key` until it is replaced; nil removes it.
  void attachValue(std::uint64_t key, const id& value);
  /// The zeroing slot that every `Weak` to this object shares.
  WeakSlot* weakSlot();

 protected:
  Object() = default;
  virtual ~Object();

 private:
  void destroy();
  ObjectExtras& extras();
  void assertOwner() const {
#ifndef NDEBUG
    assert(owner_ == std::this_thread::get_id() && "an object lives on one thread");
#endif
  }

  Class* isa_ = nullptr;
  ObjectExtras* extras_ = nullptr;
  std::uint32_t count_ = 0;
#ifndef NDEBUG
  std::thread::id owner_ = std::this_thread::get_id();
#endif
};

/// A strong reference to any object; nil by default. Sending a message to nil yields zero.
// NOLINTNEXTLINE(readability-identifier-naming): the field's own name for it.
class id {
 public:
  constexpr id() = default;
  // NOLINTBEGIN(google-explicit-constructor): an object is a reference to itself.
  constexpr id(std::nullptr_t) {}
  id(Object* object) : object_(object) { retain(); }
  // NOLINTEND(google-explicit-constructor)
  id(const id& other) : object_(other.object_) { retain(); }
  id(id&& other) noexcept : object_(std::exchange(other.object_, nullptr)) {}
  ~id() {
    if (object_ != nullptr) {
      object_->release();
    }
  }
  id& operator=(const id& other) {
    id(other).swap(*this);
    return *this;
  }
  id& operator=(id&& other) noexcept {
    id(std::move(other)).swap(*this);
    return *this;
  }

  [[nodiscard]] Object* get() const { return object_; }
  explicit operator bool() const { return object_ != nullptr; }
  void swap(id& other) noexcept { std::swap(object_, other.object_); }

  friend bool operator==(const id& left, const id& right) { return left.object_ == right.object_; }

 private:
  void retain() const {
    if (object_ != nullptr) {
      object_->retain();
    }
  }

  Object* object_ = nullptr;
};

/// A strong reference whose object is known to be a `T`. Has the layout of `id`.
template <class T>
class Ref : public id {
 public:
  constexpr Ref() = default;
  // NOLINTBEGIN(google-explicit-constructor): see id.
  constexpr Ref(std::nullptr_t) {}
  Ref(T* object) : id(object) {}
  template <class U>
  requires std::is_base_of_v<T, U> Ref(const Ref<U>& other) : id(other) {}
  template <class U>
  requires std::is_base_of_v<T, U> Ref(Ref<U>&& other) : id(std::move(other)) {}
  // NOLINTEND(google-explicit-constructor)

  [[nodiscard]] T* get() const { return static_cast<T*>(id::get()); }
  T* operator->() const { return get(); }
  T& operator*() const { return *get(); }
};

struct WeakSlot {
  Object* object = nullptr;
  std::uint32_t references = 0;
};

/// A reference that does not keep its object alive and reads as nil once the object is gone.
template <class T = Object>
class Weak {
 public:
  Weak() = default;
  // NOLINTBEGIN(google-explicit-constructor): a weak view of a strong reference.
  Weak(T* object) : slot_(object == nullptr ? nullptr : object->weakSlot()) { retain(); }
  Weak(const Ref<T>& object) : Weak(object.get()) {}
  // NOLINTEND(google-explicit-constructor)
  Weak(const Weak& other) : slot_(other.slot_) { retain(); }
  Weak(Weak&& other) noexcept : slot_(std::exchange(other.slot_, nullptr)) {}
  Weak& operator=(Weak other) noexcept {
    std::swap(slot_, other.slot_);
    return *this;
  }
  ~Weak() {
    if (slot_ != nullptr && --slot_->references == 0) {
      delete slot_;
    }
  }

  [[nodiscard]] T* get() const {
    return slot_ == nullptr ? nullptr : static_cast<T*>(slot_->object);
  }
  [[nodiscard]] Ref<T> strong() const { return Ref<T>(get()); }

 private:
  void retain() const {
    if (slot_ != nullptr) {
      ++slot_->references;
    }
  }

  WeakSlot* slot_ = nullptr;
};

}  // namespace tavro
