#pragma once

#include <any>
#include <functional>
#include <initializer_list>
#include <stdexcept>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <vector>

#include "platform/foundation/NSArray.h"
#include "platform/uikit/UIAccessibility.h"
#include "platform/uikit/UIControls.h"

namespace tavro {

inline CGRect frameOf(const id& object) { return send<CGRect>(object, "accessibilityFrame"); }
inline UIAccessibilityTraits traitsOf(const id& object) {
  return send<UIAccessibilityTraits>(object, "accessibilityTraits");
}
inline Ref<NSArray> elementsOf(const id& container) {
  return as<NSArray>(send<id>(container, "accessibilityElements"));
}
inline bool isElement(const id& object) { return send<bool>(object, "isAccessibilityElement"); }
inline bool activate(const id& object) { return send<bool>(object, "accessibilityActivate"); }

inline void setTraits(const id& object, UIAccessibilityTraits traits) {
  send<void>(object, "setAccessibilityTraits:", traits);
}
inline void setLabel(const id& object, std::string_view label) {
  send<void>(object, "setAccessibilityLabel:", string(label));
}
inline void setValue(const id& object, std::string_view value) {
  send<void>(object, "setAccessibilityValue:", string(value));
}
inline void setElements(const id& container, std::vector<id> elements) {
  send<void>(container, "setAccessibilityElements:", arrayWithObjects(std::move(elements)));
}
/// A drawn element of that container.
inline Ref<UIAccessibilityElement> drawnElement(const id& container, std::string_view label) {
  auto element = accessibilityElementWithContainer(container);
  setLabel(element, label);
  return element;
}

/// A view with these views in it.
inline Ref<UIView> group(std::initializer_list<Ref<UIView>> views,
                         CGRect frame = {0, 0, 100, 100}) {
  const auto view = makeView<UIView>(frame);
  for (const Ref<UIView>& each : views) {
    view->addSubview(each);
  }
  return view;
}

/// Sends the load hook.
inline void load(const id& object) {
  send<void>(object, "_accessibilityLoadAccessibilityInformation");
}

/// Kept on the object whose answer it is.
class TestAnswer : public NSObject {
 public:
  static constexpr Name className = "TestAnswer";
  std::any function;
};
inline const Registered testAnswer = defineClass<TestAnswer, NSObject>();

/// Answers for the objects that were told to, and lets the others answer as they did.
template <class R, class... A>
class Answering {
 public:
  void enter(Object* receiver, const Method& running) {
    super_ = Super(receiver, running);
    answer_ = static_cast<TestAnswer*>(receiver->attachedValue(keyOf(running.selector)));
  }
  R answer(A... arguments) {
    return answer_ == nullptr
               ? super_.template send<R>(arguments...)
               : std::any_cast<std::function<R(A...)>&>(answer_->function)(arguments...);
  }
  static std::uint64_t keyOf(Name selector) { return ~selector.hash(); }

 private:
  Super super_;
  TestAnswer* answer_ = nullptr;
};

/// Lets this one object of the host answer a message as a test wants it:
///   answers<double>(chart, "width", [] { return 3.0; });
template <class R, class... A>
void answers(const id& object, Name selector,
             const std::type_identity_t<std::function<R(A...)>>& function) {
  const auto answer = make<TestAnswer>();
  answer->function = function;
  object.get()->attachValue(Answering<R, A...>::keyOf(selector), answer);
  const Method* const own = object.get()->isa()->method(selector);
  const Method method = methodOf<&Answering<R, A...>::answer>(selector);
  if (own == nullptr || own->implementation != method.implementation) {
    object.get()->isa()->setMethod(method);
  }
}
/// The same for an object as the answer, whatever its class.
inline void answers(const id& object, Name selector, const id& answer) {
  answers<id>(object, selector, [answer] { return answer; });
}
/// Lets the host's own method, which a category continues in, answer for this one object.
template <class R, class... A>
void hostAnswers(const id& object, Name selector,
                 const std::type_identity_t<std::function<R(A...)>>& function) {
  const Method* const grafted = object.get()->isa()->method(selector);
  if (grafted == nullptr || grafted->replaced == nullptr) {
    throw std::logic_error("no category took the place of that method");
  }
  const_cast<Method*>(grafted->replaced)->implementation =
      methodOf<&Answering<R, A...>::answer>(selector).implementation;
  const auto answer = make<TestAnswer>();
  answer->function = function;
  object.get()->attachValue(Answering<R, A...>::keyOf(selector), answer);
}
/// Lets this one object raise when it is asked.
inline void raises(const id& object, Name selector) {
  answers<id>(object, selector, []() -> id { raise("OddException", "on purpose"); });
}

}  // namespace tavro
