#include "platform/accessibility/KeyAccess.h"

#include <algorithm>
#include <bit>
#include <memory>
#include <string>
#include <vector>

#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/NSValue.h"

namespace tavro {

/// How each key that was asked of a class is read from its instances. Grows by whole copies, so
/// that a reader never sees a table change.
struct KeyTable {
  struct Access {
    std::uint64_t key = 0;
    const Method* accessor = nullptr;
    const InstanceVariable* variable = nullptr;
    char kind = 0;  // first letter of the type encoding; 0 when there is nothing to read
  };
  std::uint64_t mask = 0;
  std::vector<Access> slots;
  std::size_t used = 0;
};

namespace {

using Access = KeyTable::Access;

const Access* find(const KeyTable& table, std::uint64_t key) {
  for (std::uint64_t index = key & table.mask;; index = (index + 1) & table.mask) {
    const Access& slot = table.slots[index];
    if (slot.key == key || slot.key == 0) {
      return slot.key == 0 ? nullptr : &slot;
    }
  }
}

void insert(KeyTable& table, const Access& access) {
  std::uint64_t index = access.key & table.mask;
  while (table.slots[index].key != 0) {
    index = (index + 1) & table.mask;
  }
  table.slots[index] = access;
  ++table.used;
}

bool isAccessor(const Method* method) {
  return method != nullptr && method->signature.encodings.find(',') == std::string_view::npos &&
         method->signature.encodings != "v";
}

/// What `Access::kind` says of a variable; a block cannot be read as a value.
char kindOf(const InstanceVariable& variable) {
  if (variable.isObject) {
    return '@';
  }
  return variable.type.starts_with("@?") ? '\0' : variable.type.front();
}

/// Decides how a key is read; the order of the candidates is the promise of safe key access.
Access resolve(Class* isa, Name key) {
  Access access{.key = key.hash()};
  const std::string text(key.text());
  if (text.empty()) {
    return access;
  }
  std::string capitalized = text;
  capitalized[0] =
      text[0] >= 'a' && text[0] <= 'z' ? static_cast<char>(text[0] - 'a' + 'A') : text[0];
  const Name underscored = Name::make("_" + text);
  for (const Name accessor : {key, Name::make("is" + capitalized), underscored}) {
    if (const Method* const method = isa->method(accessor); isAccessor(method)) {
      access.accessor = method;
      access.kind = method->signature.encodings.front();
      return access;
    }
  }
  if (!isa->isMetaclass()) {
    for (const Name name : {underscored, key}) {
      if (const InstanceVariable* const variable = isa->variable(name)) {
        access.variable = variable;
        access.kind = kindOf(*variable);
        return access;
      }
    }
  }
  return access;
}

/// Tables that were replaced; a reader on another thread may still hold one.
std::vector<std::unique_ptr<const KeyTable>>& keptTables() {
  static auto* const tables = new std::vector<std::unique_ptr<const KeyTable>>;
  return *tables;
}

const Access& remember(Class* isa, const Access& access) {
  const KeyTable* const old = isa->keyTable();
  auto table = std::make_unique<KeyTable>();
  table->slots.resize(std::bit_ceil(((old == nullptr ? 0 : old->used) + 1) * 2));
  table->mask = table->slots.size() - 1;
  if (old != nullptr) {
    for (const Access& each : old->slots) {
      if (each.key != 0) {
        insert(*table, each);
      }
    }
  }
  insert(*table, access);
  keptTables().push_back(std::move(table));
  isa->setKeyTable(keptTables().back().get());
  return *find(*isa->keyTable(), access.key);
}

/// Finds out how a key that was not asked for yet is read. Apart, so that reads stay short.
[[gnu::noinline]] const Access& learn(Class* isa, Name key) {
  const auto lock = lockClassTables();
  return remember(isa, resolve(isa, key));
}

[[gnu::always_inline]] inline const Access& accessFor(Class* isa, Name key) {
  if (const KeyTable* const table = isa->keyTable()) [[likely]] {
    if (const Access* const known = find(*table, key.hash())) [[likely]] {
      return *known;
    }
  }
  return learn(isa, key);
}

template <class T>
T call(const Object* object, const Method& accessor) {
  using Code = T (*)(Object*, const Method&);
  return reinterpret_cast<Code>(accessor.implementation)(const_cast<Object*>(object), accessor);
}

template <class T>
[[gnu::always_inline]] inline T read(const Object* object, const Access& access) {
  return access.accessor != nullptr ? call<T>(object, *access.accessor)
                                    : *static_cast<const T*>(access.variable->address(object));
}

/// Reads a primitive into a number; NO for what is none.
bool readNumber(const Object* object, const Access& access, NSNumber& into) {
  switch (access.kind) {
    case 'B':
      into.number = read<bool>(object, access);
      return true;
    case 'q':
      into.number = read<std::int64_t>(object, access);
      return true;
    case 'Q':
      into.number = read<std::uint64_t>(object, access);
      return true;
    case 'i':
      into.number = std::int64_t{read<std::int32_t>(object, access)};
      return true;
    case 'f':
      into.number = double{read<float>(object, access)};
      return true;
    case 'd':
      into.number = read<double>(object, access);
      return true;
    default:
      return false;
  }
}

/// Boxes a primitive as people expect it: a number, or a geometry value.
[[gnu::noinline]] id box(const Object* object, const Access& access) {
  if (access.kind == '#') {
    return id(read<Class*>(object, access));
  }
  if (access.kind != '{') {
    const auto boxed = make<NSNumber>();
    return readNumber(object, access, *boxed) ? boxed : nullptr;
  }
  const std::string_view type =
      access.accessor != nullptr ? access.accessor->signature.encodings : access.variable->type;
  if (type == Encoding<CGPoint>::text.view()) {
    return value(read<CGPoint>(object, access));
  }
  if (type == Encoding<CGSize>::text.view()) {
    return value(read<CGSize>(object, access));
  }
  return type == Encoding<CGRect>::text.view() ? id(value(read<CGRect>(object, access))) : id();
}

id readValue(const Object* object, Name key) {
  const Access& access = accessFor(object->isa(), key);
  if (access.kind == '@') [[likely]] {
    return read<id>(object, access);
  }
  return access.kind == 0 ? id() : box(object, access);
}

/// The number under a key as the method of a number would give it; zero for anything else. A
/// primitive needs no box for it.
template <class T>
T numberForKey(const Object* object, Name key, T (NSNumber::*convert)() const) {
  if (object == nullptr) {
    return T();
  }
  try {
    const Access& access = accessFor(object->isa(), key);
    if (NSNumber unboxed; readNumber(object, access, unboxed)) {
      return (unboxed.*convert)();
    }
    const auto found = access.kind == '@' ? as<NSNumber>(read<id>(object, access)) : nullptr;
    return found ? (found.get()->*convert)() : T();
  } catch (...) {
    return T();
  }
}

}  // namespace

id safeValueForKey(const Object* object, Name key) {
  if (object == nullptr) {
    return nullptr;
  }
  try {
    return readValue(object, key);
  } catch (...) {
    return nullptr;
  }
}

bool safeBoolForKey(const Object* object, Name key) {
  return numberForKey(object, key, &NSNumber::boolValue);
}
std::int32_t safeIntForKey(const Object* object, Name key) {
  return numberForKey(object, key, &NSNumber::intValue);
}
double safeDoubleForKey(const Object* object, Name key) {
  return numberForKey(object, key, &NSNumber::doubleValue);
}
Ref<NSString> safeStringForKey(const Object* object, Name key) {
  return typedRead<NSString>(object, key);
}
Ref<NSArray> safeArrayForKey(const Object* object, Name key) {
  return typedRead<NSArray>(object, key);
}
Ref<UIView> safeUIViewForKey(const Object* object, Name key) {
  return typedRead<UIView>(object, key);
}

id safeValueForKeyPath(const Object* object, std::string_view path) {
  id current(const_cast<Object*>(object));
  for (std::size_t start = 0; current && start <= path.size();) {
    const std::size_t end = std::min(path.find('.', start), path.size());
    id next;  // stays nil where a key is empty or cannot be a name
    AXPerformSafeBlock([&] {
      next = safeValueForKey(current.get(), Name::make(path.substr(start, end - start)));
    });
    current = next;
    start = end + 1;
  }
  return current;
}

id __UIAccessibilitySafeClass(Name className, const id& value, bool flag, bool* failed) {
  return __UIAccessibilityCastAsClass(Class::named(className), value, flag, failed);
}

id __UIAccessibilityCastAsClass(Class* isa, const id& value, bool /*unused*/, bool* failed) {
  if (!value || isKindOf(value.get(), isa)) {
    return value;
  }
  if (failed != nullptr) {
    *failed = true;
  }
  return nullptr;
}

void _accessibilitySetRetainedValue(Object* object, const id& value, Name key) {
  if (object != nullptr) {
    object->attachValue(key.hash(), value);
  }
}

id __UIAccessibilityGetAssociatedObject(const Object* object, AssociationKey key) {
  return object == nullptr ? id() : id(object->attachedValue(std::bit_cast<std::uint64_t>(key)));
}

void __UIAccessibilitySetAssociatedObject(Object* object, AssociationKey key, const id& value) {
  if (object != nullptr) {
    object->attachValue(std::bit_cast<std::uint64_t>(key), value);
  }
}

void __UIAccessibilitySetAssociatedCopiedObject(Object* object, AssociationKey key,
                                                const Ref<NSString>& value) {
  __UIAccessibilitySetAssociatedObject(object, key, value);
}

}  // namespace tavro
