#include "platform/runtime/Class.h"

#include <algorithm>
#include <bit>
#include <memory>
#include <mutex>
#include <ranges>
#include <unordered_map>

namespace tavro {
namespace {

/// Guards every change of class tables. Tables that were in use are kept: another thread may still
/// be reading one, and changes are few.
std::recursive_mutex& runtimeMutex() {
  static auto* const mutex = new std::recursive_mutex;
  return *mutex;
}

struct OwnedTable {
  DispatchTable table;
  std::vector<DispatchTable::Slot> slots;
};

std::vector<std::unique_ptr<OwnedTable>>& builtTables() {
  static auto* const tables = new std::vector<std::unique_ptr<OwnedTable>>;
  return *tables;
}

}  // namespace

std::unique_lock<std::recursive_mutex> lockClassTables() {
  return std::unique_lock(runtimeMutex());
}

Class::Class(const ClassDeclaration& declaration, Class* superclass, bool isMetaclass)
    : name_(declaration.name),
      superclass_(superclass),
      isMetaclass_(isMetaclass),
      image_(declaration.image),
      create_(isMetaclass ? nullptr : declaration.create) {
  if (superclass_ != nullptr) {
    superclass_->subclasses_.push_back(this);
  }
}

Object* Class::allocate() {
  for (Class* each = this; each != nullptr; each = each->superclass_) {
    if (each->create_ != nullptr) {
      Object* const object = each->create_();
      if (object != nullptr) {
        object->becomeInstanceOf(this);
      }
      return object;
    }
  }
  return nullptr;
}

const Method* Class::methodWithoutTable(Name selector) const {
  for (const Class* each = this; each != nullptr; each = each->superclass_) {
    for (auto method = each->methods_.rbegin(); method != each->methods_.rend(); ++method) {
      if (method->selector == selector && method->implementation != nullptr) {
        return &*method;
      }
    }
  }
  return nullptr;
}

std::vector<const Method*> Class::ownMethods() const {
  std::vector<const Method*> own;
  for (const Method& method : methods_) {
    const bool superseded = std::ranges::any_of(
        methods_, [&](const Method& other) { return other.replaced == &method; });
    if (!superseded && method.implementation != nullptr) {
      own.push_back(&method);
    }
  }
  return own;
}

const Method* Class::setMethod(Method method) {
  const std::lock_guard lock(runtimeMutex());
  method.owner = this;
  method.replaced = nullptr;
  for (const Method& own : methods_) {
    if (own.selector == method.selector && own.implementation != nullptr) {
      method.replaced = &own;  // the last one declared is the one in force
    }
  }
  methods_.push_back(method);
  invalidate();
  return &methods_.back();
}

void Class::removeMethod(Name selector) {
  const std::lock_guard lock(runtimeMutex());
  for (Method& method : methods_) {
    if (method.selector == selector) {
      method.implementation = nullptr;
    }
  }
  invalidate();
}

const InstanceVariable* Class::variable(Name name) const {
  for (const Class* each = this; each != nullptr; each = each->superclass_) {
    for (const InstanceVariable& variable : each->variables_) {
      if (variable.name == name) {
        return &variable;
      }
    }
  }
  return nullptr;
}

void Class::setVariable(const InstanceVariable& variable) {
  const std::lock_guard lock(runtimeMutex());
  removeVariable(variable.name);
  variables_.push_back(variable);
}

void Class::removeVariable(Name name) {
  const std::lock_guard lock(runtimeMutex());
  std::erase_if(variables_, [&](const InstanceVariable& each) { return each.name == name; });
  invalidate();
}

bool Class::conformsTo(Name protocol) const {
  for (const Class* each = this; each != nullptr; each = each->superclass_) {
    if (std::ranges::find(each->protocols_, protocol) != each->protocols_.end()) {
      return true;
    }
  }
  return false;
}

void Class::invalidate() {
  table_.store(nullptr, std::memory_order_release);
  keyTable_.store(nullptr, std::memory_order_release);
  for (Class* subclass : subclasses_) {
    subclass->invalidate();
  }
}

void Class::collect(std::vector<const Method*>& into) const {
  if (superclass_ != nullptr) {
    superclass_->collect(into);
  }
  for (const Method& method : methods_) {
    if (method.implementation != nullptr) {
      into.push_back(&method);
    }
  }
}

const DispatchTable* Class::buildTable() {
  const std::lock_guard lock(runtimeMutex());
  if (const DispatchTable* ready = table_.load(std::memory_order_acquire)) {
    return ready;
  }
  std::vector<const Method*> methods;
  collect(methods);
  auto owned = std::make_unique<OwnedTable>();
  // At most half full, so that a probe almost always ends at its first slot.
  owned->slots.resize(std::bit_ceil(methods.size() * 2 + 2));
  owned->table = {owned->slots.size() - 1, owned->slots.data()};
  for (const Method* method : methods) {
    std::uint64_t index = method->selector.hash() & owned->table.mask;
    while (owned->slots[index].selector != 0 &&
           owned->slots[index].selector != method->selector.hash()) {
      index = (index + 1) & owned->table.mask;
    }
    owned->slots[index] = {method->selector.hash(), method->signature.hash, method->implementation,
                           method};
  }
  builtTables().push_back(std::move(owned));
  const DispatchTable* table = &builtTables().back()->table;
  table_.store(table, std::memory_order_release);
  return table;
}

// Declarations wait here until a class is looked up.
class ClassRegistry {
 public:
  static ClassRegistry& shared() {
    static auto* const registry = new ClassRegistry;
    return *registry;
  }

  Class* named(Name name) {
    if (hasPending_.load(std::memory_order_acquire)) {
      const std::lock_guard lock(runtimeMutex());
      makePending();
    }
    const DirectoryTable* directory = directory_.load(std::memory_order_acquire);
    return directory == nullptr ? nullptr : directory->find(name);
  }

  void declare(ClassDeclaration declaration) {
    const std::lock_guard lock(runtimeMutex());
    declaration.image = image_;
    pending_.push_back(std::move(declaration));
    hasPending_.store(true, std::memory_order_release);
  }

  std::vector<RegistrationProblem> problems() {
    const std::lock_guard lock(runtimeMutex());
    makePending();
    std::vector<RegistrationProblem> all = problems_;
    for (const ClassDeclaration& waiting : pending_) {
      const Name missing = waiting.extendsOnly ? waiting.name : waiting.superclass;
      all.push_back({std::string(waiting.name.text()),
                     "the class \"" + std::string(missing.text()) + "\" is not loaded"});
    }
    return all;
  }

  std::vector<Class*> ofImage(std::string_view image) {
    const std::lock_guard lock(runtimeMutex());
    makePending();
    std::vector<Class*> found;
    std::ranges::copy_if(classes_, std::back_inserter(found),
                         [&](const Class* each) { return each->image() == image; });
    return found;
  }

  void forget(Name name) {
    const std::lock_guard lock(runtimeMutex());
    std::erase_if(classes_, [&](const Class* each) { return each->name() == name; });
    byName_.erase(name.hash());
    forgotten_.push_back(name);
    publish();
  }

  void setImage(std::string_view path) { image_ = path; }

 private:
  struct DirectoryTable {
    std::uint64_t mask;
    std::vector<Class*> slots;

    [[nodiscard]] Class* find(Name name) const {
      for (std::uint64_t index = name.hash() & mask;; index = (index + 1) & mask) {
        if (slots[index] == nullptr || slots[index]->name() == name) {
          return slots[index];
        }
      }
    }
  };

  void makePending() {
    bool progress = true;
    bool changed = false;
    while (progress && !pending_.empty()) {
      progress = false;
      std::vector<ClassDeclaration> waiting;
      std::swap(waiting, pending_);
      for (ClassDeclaration& declaration : waiting) {
        const Name needed = declaration.extendsOnly ? declaration.name : declaration.superclass;
        if (!needed.empty() && find(needed) == nullptr) {
          pending_.push_back(std::move(declaration));
          continue;
        }
        make(declaration);
        progress = changed = true;
      }
    }
    hasPending_.store(false, std::memory_order_release);
    if (changed) {
      publish();
    }
  }

  Class* find(Name name) {
    const auto found = byName_.find(name.hash());
    return found == byName_.end() ? nullptr : found->second;
  }

  void make(const ClassDeclaration& declaration) {
    if (const std::string reason = refusal(declaration); !reason.empty()) {
      problems_.push_back({std::string(declaration.name.text()), reason});
      return;
    }
    Class* isa = find(declaration.name);
    if (!declaration.extendsOnly) {
      Class* const superclass = find(declaration.superclass);
      isa = new Class(declaration, superclass, false);
      auto* meta =
          new Class(declaration, superclass == nullptr ? nullptr : superclass->isa(), true);
      isa->becomeInstanceOf(meta);
      meta->becomeInstanceOf(meta);
      isa->retain();
      meta->retain();
      classes_.push_back(isa);
      byName_.emplace(isa->name().hash(), isa);
    }
    for (const InstanceVariable& variable : declaration.variables) {
      isa->setVariable(variable);
    }
    std::ranges::copy(declaration.protocols, std::back_inserter(isa->protocols_));
    for (const Method& method : declaration.methods) {
      isa->setMethod(method);
    }
    for (const Method& method : declaration.classMethods) {
      isa->isa()->setMethod(method);
    }
  }

  /// Why a declaration cannot be carried out; empty when it can.
  std::string refusal(const ClassDeclaration& declaration) {
    const bool isTaken = find(declaration.name) != nullptr ||
                         std::ranges::find(forgotten_, declaration.name) != forgotten_.end();
    if (!declaration.extendsOnly && isTaken) {
      return "a class of this name is already registered";
    }
    std::vector<Name> names{declaration.name};
    for (const auto* methods : {&declaration.methods, &declaration.classMethods}) {
      std::ranges::transform(*methods, std::back_inserter(names), &Method::selector);
    }
    std::ranges::transform(declaration.variables, std::back_inserter(names),
                           &InstanceVariable::name);
    std::ranges::copy(declaration.protocols, std::back_inserter(names));
    for (const Name name : names) {
      if (NameTable::shared().add(name.hash(), name.text()) == nullptr) {
        return "the name \"" + std::string(name.text()) + "\" has the hash of another name";
      }
    }
    return {};
  }

  void publish() {
    auto directory = std::make_unique<DirectoryTable>();
    directory->slots.resize(std::bit_ceil(classes_.size() * 2 + 2));
    directory->mask = directory->slots.size() - 1;
    for (Class* each : classes_) {
      std::uint64_t index = each->name().hash() & directory->mask;
      while (directory->slots[index] != nullptr) {
        index = (index + 1) & directory->mask;
      }
      directory->slots[index] = each;
    }
    directories_.push_back(std::move(directory));
    directory_.store(directories_.back().get(), std::memory_order_release);
  }

  std::vector<ClassDeclaration> pending_;
  std::vector<Class*> classes_;  // in the order of their declaration
  std::unordered_map<std::uint64_t, Class*> byName_;
  std::vector<Name> forgotten_;
  std::vector<RegistrationProblem> problems_;
  std::vector<std::unique_ptr<DirectoryTable>> directories_;
  std::atomic<const DirectoryTable*> directory_{nullptr};
  std::atomic<bool> hasPending_{false};
  std::string_view image_;
};

Class* Class::named(Name name) { return ClassRegistry::shared().named(name); }

void declareClass(ClassDeclaration declaration) noexcept {
  ClassRegistry::shared().declare(std::move(declaration));
}
std::vector<RegistrationProblem> registrationProblems() {
  return ClassRegistry::shared().problems();
}
std::vector<Class*> classesOfImage(std::string_view image) {
  return ClassRegistry::shared().ofImage(image);
}
void forgetClass(Name name) { ClassRegistry::shared().forget(name); }

ImageScope::ImageScope(std::string_view path) {
  ClassRegistry::shared().setImage(Name::make(path).text());
}
ImageScope::~ImageScope() { ClassRegistry::shared().setImage({}); }

}  // namespace tavro
