#pragma once

#include <atomic>
#include <deque>
#include <mutex>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "platform/runtime/Encoding.h"
#include "platform/runtime/Exception.h"
#include "platform/runtime/Name.h"
#include "platform/runtime/Object.h"

namespace tavro {

/// Code of any signature; cast back to the exact type once the signature has been compared.
using Implementation = void (*)();

/// One method of one class. Its address is stable for the life of the process.
struct Method {
  Name selector = {};
  Signature signature = {};
  Implementation implementation = nullptr;
  /// The class whose method this is; messages to `super` continue above it.
  Class* owner = nullptr;
  /// The method of the same class whose place this one took, or nullptr.
  const Method* replaced = nullptr;
  /// The class that this method was grafted from, or nullptr for a method of the class itself.
  Class* graftedFrom = nullptr;
};

/// A variable of every instance, readable by name.
struct InstanceVariable {
  Name name = {};
  /// "B", "q", "d", "f" ... or, for an object, the name of the class that it holds.
  std::string_view type = {};
  /// True when the variable is an object reference.
  bool isObject = false;
  /// Where the variable is inside an instance.
  const void* (*address)(const Object*) = nullptr;
};

/// A hash table that is built whole and then only read, from any thread.
struct DispatchTable {
  struct Slot {
    std::uint64_t selector = 0;
    std::uint64_t signature = 0;
    Implementation implementation = nullptr;
    const Method* method = nullptr;
  };
  std::uint64_t mask = 0;
  const Slot* slots = nullptr;
};

struct KeyTable;

/// What a class declares; see `defineClass` for the builder.
struct ClassDeclaration {
  Name name = {};
  Name superclass = {};      ///< empty for a root class
  bool extendsOnly = false;  ///< an ordinary category: adds methods to an existing class
  Object* (*create)() = nullptr;
  std::vector<InstanceVariable> variables = {};
  std::vector<Method> methods = {};
  std::vector<Method> classMethods = {};
  std::vector<Name> protocols = {};
  std::string_view image = {};  ///< path of the bundle that declares it; empty for the executable
};

/// A class and, as one mechanism, its metaclass: a class object's own class, whose methods are the
/// class methods (those alone: a class object does not answer instance methods). Found by name;
/// never destroyed. Lookup is safe from any thread.
class Class final : public Object {
 public:
  /// The class of that name, or nullptr when none is loaded.
  static Class* named(Name name);

  [[nodiscard]] Name name() const { return name_; }
  [[nodiscard]] Class* superclass() const { return superclass_; }
  [[nodiscard]] bool isMetaclass() const { return isMetaclass_; }
  [[nodiscard]] bool isSubclassOf(const Class* other) const {
    for (const Class* each = this; each != nullptr; each = each->superclass_) {
      if (each == other) {
        return true;
      }
    }
    return false;
  }
  /// Path of the bundle that declares the class; empty for the executable and the platform.
  [[nodiscard]] std::string_view image() const { return image_; }

  /// A new instance with a count of 0, or nullptr when the class cannot be instantiated.
  [[nodiscard]] Object* allocate();

  /// The slot that a message with this selector reaches, or nullptr.
  [[nodiscard]] const DispatchTable::Slot* lookup(Name selector) {
    const DispatchTable* table = table_.load(std::memory_order_acquire);
    if (table == nullptr) [[unlikely]] {
      table = buildTable();
    }
    for (std::uint64_t index = selector.hash() & table->mask;; index = (index + 1) & table->mask) {
      const DispatchTable::Slot& slot = table->slots[index];
      if (slot.selector == selector.hash()) [[likely]] {
        return &slot;
      }
      if (slot.selector == 0) {
        return nullptr;
      }
    }
  }
  /// The method that a message with this selector reaches, or nullptr.
  [[nodiscard]] const Method* method(Name selector) {
    const DispatchTable::Slot* slot = lookup(selector);
    return slot == nullptr ? nullptr : slot->method;
  }
  /// The same without building the class's table: for lookups between changes.
  [[nodiscard]] const Method* methodWithoutTable(Name selector) const;
  /// This class's own methods, replaced ones left out, in the order of their declaration.
  [[nodiscard]] std::vector<const Method*> ownMethods() const;

  /// Adds a method, or takes the place of this class's own method of that selector. The one
  /// mechanism behind declarations, ordinary categories and grafting.
  const Method* setMethod(Method method);
  /// Takes this class's own method away again; messages then reach what lies above.
  void removeMethod(Name selector);

  [[nodiscard]] const InstanceVariable* variable(Name name) const;
  /// This class's own variables, in the order of their declaration.
  [[nodiscard]] std::span<const InstanceVariable> ownVariables() const { return variables_; }
  /// Adds a variable or replaces the one of the same name.
  void setVariable(const InstanceVariable& variable);
  void removeVariable(Name name);

  [[nodiscard]] bool conformsTo(Name protocol) const;

  /// How keys are read from instances; kept here so that it is dropped whenever methods or
  /// variables change. Owned by safe key access.
  [[nodiscard]] const KeyTable* keyTable() const {
    return keyTable_.load(std::memory_order_acquire);
  }
  void setKeyTable(const KeyTable* table) { keyTable_.store(table, std::memory_order_release); }

 private:
  friend class ClassRegistry;
  Class(const ClassDeclaration& declaration, Class* superclass, bool isMetaclass);
  ~Class() override = default;

  const DispatchTable* buildTable();
  void collect(std::vector<const Method*>& into) const;
  void invalidate();

  Name name_;
  Class* superclass_;
  bool isMetaclass_;
  std::string_view image_;
  Object* (*create_)();
  std::deque<Method> methods_;  // superseded methods stay: `replaced` points at them
  std::vector<InstanceVariable> variables_;
  std::vector<Name> protocols_;
  std::vector<Class*> subclasses_;
  std::atomic<const DispatchTable*> table_{nullptr};
  std::atomic<const KeyTable*> keyTable_{nullptr};
};

/// Keeps class tables from changing; for what is built of them and kept beside them.
[[nodiscard]] std::unique_lock<std::recursive_mutex> lockClassTables();

/// A declaration that could not be carried out.
struct RegistrationProblem {
  std::string className;
  std::string reason;
};

/// Records a declaration. Never throws: it may run before `main` and in any order, so a class is
/// made when it is first looked up and its superclass is known by then.
void declareClass(ClassDeclaration declaration) noexcept;
/// Makes every declared class that can be made, and yields what could not be, oldest first.
std::vector<RegistrationProblem> registrationProblems();
/// The classes declared by the bundle at that path, in the order of their declaration.
std::vector<Class*> classesOfImage(std::string_view image);
/// Removes a class from lookup by name; its instances stay usable and its name stays taken.
void forgetClass(Name name);

/// While one exists, declarations are recorded as coming from the bundle at `path`.
class ImageScope {
 public:
  explicit ImageScope(std::string_view path);
  ~ImageScope();
  ImageScope(const ImageScope&) = delete;
  ImageScope& operator=(const ImageScope&) = delete;
};

/// Whether the object is an instance of that class or of a subclass of it; NO for nil.
inline bool isKindOf(const Object* object, const Class* isa) {
  return object != nullptr && isa != nullptr && object->isa()->isSubclassOf(isa);
}

/// The class that a native type stands for, or nullptr when it is not loaded.
template <class T>
Class* classOf() {
  return Class::named(T::className);
}

/// Whether the object is an instance of the class that a native type stands for. A class's name is
/// its own for the life of the process, so the names along the superclasses tell.
template <class T>
bool isA(const Object* object) {
  if (object == nullptr || object->isa()->isMetaclass()) {
    return false;
  }
  for (const Class* each = object->isa(); each != nullptr; each = each->superclass()) {
    if (each->name() == T::className) {
      return true;
    }
  }
  return false;
}

/// The object as a `T` when it is one, else nil.
template <class T>
Ref<T> as(const id& object) {
  return isA<T>(object.get()) ? Ref<T>(static_cast<T*>(object.get())) : Ref<T>();
}
template <class T>
Ref<T> as(id&& object) {
  Ref<T> result;
  if (isA<T>(object.get())) {
    result.swap(object);
  }
  return result;
}

}  // namespace tavro
