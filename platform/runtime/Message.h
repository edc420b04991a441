#pragma once

#include <cmath>
#include <concepts>
#include <limits>
#include <utility>

#include "platform/runtime/Class.h"

namespace tavro {

/// The one conversion from floating point to integers: truncates toward zero, saturates at the
/// ends of the type, and turns what is not a number into 0.
template <std::integral I>
constexpr I saturatingCast(double value) {
  using Limits = std::numeric_limits<I>;
  if (value != value) {
    return 0;
  }
  // The upper end may round up to a value outside the type, so it is excluded.
  if (value >= static_cast<double>(Limits::max())) {
    return Limits::max();
  }
  if (value <= static_cast<double>(Limits::min())) {
    return Limits::min();
  }
  return static_cast<I>(value);
}

namespace message {

[[noreturn]] void raiseUnknownSelector(const Object* receiver, Name selector);
[[noreturn]] void raiseWrongSignature(const Object* receiver, const Method& method,
                                      Signature called);
[[noreturn]] void raiseWrongClass(const Object* object, Name expected);

/// How an argument of the call site becomes the type that travels.
template <class T>
TravelArgument<T> travel(const T& argument) {
  using Value = std::decay_t<T>;
  if constexpr (kIsReference<Value>) {
    return argument.get();
  } else {
    return static_cast<TravelArgument<T>>(argument);
  }
}

/// How a travelled argument becomes the type that an implementation asked for. A narrower object
/// type gets a checked cast.
template <class T>
decltype(auto) receive(TravelArgument<T> argument) {
  using Value = std::decay_t<T>;
  if constexpr (std::is_same_v<Value, id> || std::is_same_v<Value, Object*>) {
    return Value(argument);
  } else if constexpr (kIsReference<Value> ||
                       (kIsObjectPointer<Value> && !std::is_same_v<Value, Class*>)) {
    using Target = std::remove_reference_t<decltype(*std::declval<Value>())>;
    if (argument != nullptr && !isA<Target>(argument)) {
      raiseWrongClass(argument, Target::className);
    }
    return Value(static_cast<Target*>(argument));
  } else if constexpr (std::is_enum_v<Value>) {
    return static_cast<Value>(argument);
  } else {
    // NOLINTNEXTLINE(bugprone-sizeof-expression): of pointers, whose size is right, too
    static_assert(!std::is_integral_v<Value> || sizeof(Value) == 8 || std::is_same_v<Value, bool>,
                  "integers travel as 64 bits; take one");
    return argument;
  }
}

template <class R, class... A>
R invoke(Object* receiver, const DispatchTable::Slot* slot, Name selector, const A&... arguments) {
  using Result = TravelResult<R>;
  constexpr Signature signature = kSignature<Result, TravelArgument<A>...>;
  if (slot == nullptr) [[unlikely]] {
    raiseUnknownSelector(receiver, selector);
  }
  if (slot->signature != signature.hash) [[unlikely]] {
    raiseWrongSignature(receiver, *slot->method, signature);
  }
  using Code = Result (*)(Object*, const Method&, TravelArgument<A>...);
  return static_cast<R>(
      reinterpret_cast<Code>(slot->implementation)(receiver, *slot->method, travel(arguments)...));
}

}  // namespace message

/// Sends a message. Nil yields R's zero value. Raises when the receiver has no such method or when
/// the method's signature differs from the call's: a wrong call is an exception, never more.
template <class R, class... A>
R send(Object* receiver, Name selector, const A&... arguments) {
  if (receiver == nullptr) {
    return R();
  }
  return message::invoke<R>(receiver, receiver->isa()->lookup(selector), selector, arguments...);
}
template <class R, class... A>
R send(const id& receiver, Name selector, const A&... arguments) {
  return send<R>(receiver.get(), selector, arguments...);
}

/// Sends a message and yields R's zero value when anything raises.
template <class R, class Receiver, class... A>
R trySend(const Receiver& receiver, Name selector, const A&... arguments) {
  try {
    return send<R>(receiver, selector, arguments...);
  } catch (...) {
    return R();
  }
}

/// Continues a message in what lies above `owner`, the class whose method is running.
template <class R, class... A>
R sendSuper(Class* owner, Object* receiver, Name selector, const A&... arguments) {
  Class* const above = owner->superclass();
  return message::invoke<R>(receiver, above == nullptr ? nullptr : above->lookup(selector),
                            selector, arguments...);
}

/// Whether a message with this selector would find a method; NO for nil.
inline bool respondsTo(const Object* object, Name selector) {
  return object != nullptr && object->isa()->lookup(selector) != nullptr;
}

/// Continues the running method of a facade in what it took the place of: the target's own
/// method, else whatever the target's superclass answers now. Raises when there is nothing.
class Super {
 public:
  Super() = default;
  Super(Object* receiver, const Method& running) : receiver_(receiver), running_(&running) {}

  template <class R, class... A>
  R send(const A&... arguments) const {
    const Method* const replaced = running_->replaced;
    if (replaced != nullptr && replaced->implementation != nullptr) {  // not taken away since
      const DispatchTable::Slot slot{replaced->selector.hash(), replaced->signature.hash,
                                     replaced->implementation, replaced};
      return message::invoke<R>(receiver_, &slot, replaced->selector, arguments...);
    }
    return sendSuper<R>(running_->owner, receiver_, running_->selector, arguments...);
  }

 private:
  Object* receiver_ = nullptr;
  const Method* running_ = nullptr;
};

/// A type whose methods run on behalf of another object: made for the length of one call.
template <class T>
concept Facade = requires(T facade, Object* receiver, const Method& running) {
  facade.enter(receiver, running);
};

namespace message {

/// The code behind a method of a given C++ function, in the form that `send` calls.
template <auto F, class Type = decltype(F)>
struct Binder;

template <auto F, class T, class R, class... A>
struct MemberBinder {
  static constexpr tavro::Signature signature = kSignature<TravelResult<R>, TravelArgument<A>...>;

  static TravelResult<R> call(Object* receiver, const Method& running,
                              TravelArgument<A>... arguments) {
    if constexpr (Facade<T>) {
      T facade;
      facade.enter(receiver, running);
      return static_cast<TravelResult<R>>((facade.*F)(receive<A>(arguments)...));
    } else {
      return static_cast<TravelResult<R>>(
          (static_cast<T*>(receiver)->*F)(receive<A>(arguments)...));
    }
  }
};
template <auto F, class T, class R, class... A>
struct Binder<F, R (T::*)(A...)> : MemberBinder<F, T, R, A...> {};
template <auto F, class T, class R, class... A>
struct Binder<F, R (T::*)(A...) const> : MemberBinder<F, T, R, A...> {};

/// A free function takes the receiver as its first argument: an object or a class.
template <auto F, class Receiver, class R, class... A>
struct Binder<F, R (*)(Receiver*, A...)> {
  static constexpr tavro::Signature signature = kSignature<TravelResult<R>, TravelArgument<A>...>;

  static TravelResult<R> call(Object* receiver, const Method& /*running*/,
                              TravelArgument<A>... arguments) {
    return static_cast<TravelResult<R>>(
        F(static_cast<Receiver*>(receiver), receive<A>(arguments)...));
  }
};

}  // namespace message

/// The method of a C++ function under a selector.
template <auto F>
Method methodOf(Name selector) {
  using Code = message::Binder<F>;
  return {.selector = selector,
          .signature = Code::signature,
          .implementation = reinterpret_cast<Implementation>(&Code::call)};
}

/// Builds a class declaration from a native type:
///   const Registered label = defineClass<UILabel, UIView>().method<&UILabel::text>("text");
/// A native type names its class in `static constexpr Name className`.
class ClassBuilder {
 public:
  explicit ClassBuilder(ClassDeclaration declaration) : declaration_(std::move(declaration)) {}

  template <auto F>
  ClassBuilder&& method(Name selector) && {
    declaration_.methods.push_back(methodOf<F>(selector));
    return std::move(*this);
  }
  template <auto F>
  ClassBuilder&& classMethod(Name selector) && {
    declaration_.classMethods.push_back(methodOf<F>(selector));
    return std::move(*this);
  }
  template <auto Member>
  ClassBuilder&& variable(Name name) && {
    declaration_.variables.push_back(variableOf(name, MemberTag<Member>{}));
    return std::move(*this);
  }
  ClassBuilder&& protocol(Name name) && {
    declaration_.protocols.push_back(name);
    return std::move(*this);
  }
  ClassDeclaration take() && { return std::move(declaration_); }

 private:
  template <auto Member>
  struct MemberTag {};

  template <class T, class V, V T::*Member>
  static InstanceVariable variableOf(Name name, MemberTag<Member> /*tag*/) {
    InstanceVariable variable{.name = name};
    if constexpr (std::is_same_v<V, id>) {
      variable.type = "@";
    } else if constexpr (kIsReference<V>) {
      using Held = std::remove_pointer_t<decltype(std::declval<V>().operator->())>;
      variable.type = Held::className.text();
    } else {
      variable.type = Encoding<V>::text.view();
    }
    variable.isObject = kIsReference<V>;
    variable.address = [](const Object* object) -> const void* {
      const auto& member = static_cast<const T*>(object)->*Member;
      if constexpr (kIsReference<V>) {
        return static_cast<const id*>(&member);
      } else {
        return &member;
      }
    };
    return variable;
  }

  ClassDeclaration declaration_;
};

template <class T, class Superclass>
ClassBuilder defineClass() {
  static_assert(std::is_base_of_v<Superclass, T>);
  ClassDeclaration declaration{.name = T::className, .superclass = Superclass::className};
  if constexpr (std::is_default_constructible_v<T>) {
    declaration.create = []() -> Object* { return new T; };
  } else {
    // Not what the superclass would make: T's methods need a T.
    declaration.create = []() -> Object* { return nullptr; };
  }
  return ClassBuilder(std::move(declaration));
}

/// An ordinary category: methods for an existing class, present from load.
inline ClassBuilder extendClass(Name name) {
  return ClassBuilder({.name = name, .extendsOnly = true});
}

/// Declares a class when a static object of this type is constructed.
struct Registered {
  // NOLINTNEXTLINE(google-explicit-constructor): reads as a declaration.
  Registered(ClassBuilder&& builder) { declareClass(std::move(builder).take()); }
};

/// A new object of a native type, not yet initialised by any `init` method.
template <class T>
Ref<T> make() {
  static Class* const isa = classOf<T>();  // a class is its name's for the life of the process
  return Ref<T>(static_cast<T*>(isa->allocate()));
}

}  // namespace tavro
