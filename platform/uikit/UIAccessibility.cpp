#include "platform/uikit/UIAccessibility.h"

#include <unordered_map>

#include "platform/accessibility/Labels.h"
#include "platform/foundation/Settings.h"
#include "platform/uikit/UIView.h"

namespace tavro {

void AccessibilityAttributesDeleter::operator()(AccessibilityAttributes* attributes) const {
  delete attributes;
}

AccessibilityAttributes& accessibilityAttributes(NSObject& object) {
  if (!object.accessibility) {
    object.accessibility.reset(new AccessibilityAttributes);
  }
  return *object.accessibility;
}

namespace {

using Attributes = AccessibilityAttributes;
using Rare = AccessibilityAttributes::Rare;
using Traits = UIAccessibilityTraits;

Rare& rareOf(NSObject& object) {
  auto& rare = accessibilityAttributes(object).rare;
  if (!rare) {
    rare = std::make_unique<Rare>();
  }
  return *rare;
}

/// What was set of the rare kind, else its zero value.
template <auto Member>
auto storedRare(NSObject* self) {
  using Value = std::remove_cvref_t<decltype(std::declval<Rare>().*Member)>;
  return self->accessibility && self->accessibility->rare ? (*self->accessibility->rare).*Member
                                                          : Value();
}

template <auto Member, class Value>
void storeRare(NSObject* self, Value value) {
  rareOf(*self).*Member = std::move(value);
}

/// The block of that kind, or nullptr when none is set.
template <class Block>
const Block* blockOf(const NSObject& self, Block Rare::*kind) {
  if (!self.accessibility || !self.accessibility->rare) {
    return nullptr;
  }
  const Block& block = (*self.accessibility->rare).*kind;
  return block ? &block : nullptr;
}

// The first two answers of each attribute; the third is the class's own.

id label(NSObject* self) {
  if (const LabelBlock* block = blockOf(*self, &Rare::label)) {
    return LabelBlock(*block)();
  }
  if (self->accessibility && self->accessibility->label) {
    return self->accessibility->label;
  }
  return send<id>(self, "_naturalAccessibilityLabel");
}

id valueOf(NSObject* self) {
  if (const LabelBlock* block = blockOf(*self, &Rare::value)) {
    return LabelBlock(*block)();
  }
  if (self->accessibility && self->accessibility->value) {
    return self->accessibility->value;
  }
  return send<id>(self, "_naturalAccessibilityValue");
}

bool isElement(NSObject* self) {
  if (const FlagBlock* block = blockOf(*self, &Rare::isElement)) {
    return FlagBlock(*block)();
  }
  if (self->accessibility && self->accessibility->isElement.has_value()) {
    return *self->accessibility->isElement;
  }
  return send<bool>(self, "_naturalIsAccessibilityElement");
}

bool activate(NSObject* self) {
  if (const FlagBlock* block = blockOf(*self, &Rare::activate)) {
    return FlagBlock(*block)();
  }
  return send<bool>(self, "_naturalAccessibilityActivate");
}

UIAccessibilityTraits traits(NSObject* self) {
  return self->accessibility && self->accessibility->traits.has_value()
             ? *self->accessibility->traits
             : send<UIAccessibilityTraits>(self, "_naturalAccessibilityTraits");
}

id container(NSObject* self) {
  if (self->accessibility) {
    if (const id set = self->accessibility->container.strong()) {
      return set;
    }
  }
  return send<id>(self, "_naturalAccessibilityContainer");
}

id ancestorOfKind(NSObject* self, Class* isa) {
  constexpr int deepest = 1000;  // containers may form a cycle
  id each = trySend<id>(self, "accessibilityContainer");
  for (int depth = 0; each && depth < deepest; ++depth) {
    if (isKindOf(each.get(), isa)) {
      return each;
    }
    each = trySend<id>(each, "accessibilityContainer");
  }
  return nullptr;
}

CGRect frame(NSObject* self) {
  if (!self->accessibility || !self->accessibility->frame.has_value()) {
    return send<CGRect>(self, "_naturalAccessibilityFrame");
  }
  const CGRect set = *self->accessibility->frame;
  if (self->accessibility->frameIsInContainerSpace) {
    auto view = as<UIView>(trySend<id>(self, "accessibilityContainer"));
    if (!view) {
      view = as<UIView>(ancestorOfKind(self, classOf<UIView>()));
    }
    return UIAccessibilityConvertFrameToScreenCoordinates(set, view);
  }
  return set;
}

CGPoint activationPoint(NSObject* self) {
  const std::optional<CGPoint> set = storedRare<&Rare::activationPoint>(self);
  return set ? *set : send<CGRect>(self, "accessibilityFrame").center();
}

id elements(NSObject* self) {
  if (self->accessibility && self->accessibility->elements) {
    return self->accessibility->elements;
  }
  return send<id>(self, "_naturalAccessibilityElements");
}

/// What is stored and read without a natural answer of a class.
template <auto Member>
auto stored(NSObject* self) {
  using Value = std::remove_cvref_t<decltype(std::declval<AccessibilityAttributes>().*Member)>;
  return self->accessibility ? (*self->accessibility).*Member : Value();
}

template <auto Member, class Value>
void store(NSObject* self, Value value) {
  accessibilityAttributes(*self).*Member = value;
}

template <bool IsInContainerSpace>
void setFrame(NSObject* self, CGRect rect) {
  Attributes& attributes = accessibilityAttributes(*self);
  attributes.frame = rect;
  attributes.frameIsInContainerSpace = IsInContainerSpace;
}

void setContainer(NSObject* self, id object) {
  accessibilityAttributes(*self).container = Weak<>(object.get());
}

void addTrait(NSObject* self, UIAccessibilityTraits trait) {
  send<void>(self, "setAccessibilityTraits:",
             send<UIAccessibilityTraits>(self, "accessibilityTraits") | trait);
}

id labelForKeys(NSObject* self, Ref<NSString> keys) {
  return stringForLabelKeyValues(id(self), utf8(keys));
}

template <class Answer>
Answer nothing(NSObject* /*self*/) {
  return Answer();
}
bool alwaysVisible(NSObject* /*self*/) { return true; }
id hitNothing(NSObject* self, CGPoint /*point*/, id /*event*/) { return self; }

const Registered attributes =
    extendClass("NSObject")
        .method<&label>("accessibilityLabel")
        .method<&store<&Attributes::label, id>>("setAccessibilityLabel:")
        .method<&stored<&Attributes::label>>("accessibilityUserDefinedLabel")
        .method<&valueOf>("accessibilityValue")
        .method<&store<&Attributes::value, id>>("setAccessibilityValue:")
        .method<&stored<&Attributes::hint>>("accessibilityHint")
        .method<&store<&Attributes::hint, id>>("setAccessibilityHint:")
        .method<&isElement>("isAccessibilityElement")
        .method<&store<&Attributes::isElement, bool>>("setIsAccessibilityElement:")
        .method<&traits>("accessibilityTraits")
        .method<&store<&Attributes::traits, Traits>>("setAccessibilityTraits:")
        .method<&addTrait>("_accessibilityAddTrait:")
        .method<&frame>("accessibilityFrame")
        .method<&setFrame<false>>("setAccessibilityFrame:")
        .method<&setFrame<true>>("setAccessibilityFrameInContainerSpace:")
        .method<&nothing<id>>("accessibilityPath")
        .method<&activationPoint>("accessibilityActivationPoint")
        .method<&storeRare<&Rare::activationPoint, CGPoint>>("setAccessibilityActivationPoint:")
        .method<&container>("accessibilityContainer")
        .method<&setContainer>("setAccessibilityContainer:")
        .method<&elements>("accessibilityElements")
        .method<&store<&Attributes::elements, Ref<NSArray>>>("setAccessibilityElements:")
        .method<&stored<&Attributes::elementsHidden>>("accessibilityElementsHidden")
        .method<&store<&Attributes::elementsHidden, bool>>("setAccessibilityElementsHidden:")
        .method<&stored<&Attributes::viewIsModal>>("accessibilityViewIsModal")
        .method<&store<&Attributes::viewIsModal, bool>>("setAccessibilityViewIsModal:")
        .method<&storedRare<&Rare::identification>>("accessibilityIdentification")
        .method<&storeRare<&Rare::identification, id>>("accessibilitySetIdentification:");

const Registered behaviour =
    extendClass("NSObject")
        .method<&activate>("accessibilityActivate")
        .method<&nothing<void>>("accessibilityIncrement")
        .method<&nothing<void>>("accessibilityDecrement")
        .method<&nothing<void>>("_accessibilityLoadAccessibilityInformation")
        .method<&nothing<std::int64_t>>("_accessibilityExpandedStatus")
        .method<&hitNothing>("_accessibilityHitTest:withEvent:")
        .method<&store<&Attributes::overridesInvisibility, bool>>(
            "_accessibilitySetOverridesInvisibility:")
        .method<&store<&Attributes::viewIsVisible, bool>>("_accessibilitySetViewIsVisible:")
        .method<&alwaysVisible>("_accessibilityViewIsVisible")
        .method<&storeRare<&Rare::label, LabelBlock>>("_setAccessibilityLabelBlock:")
        .method<&storeRare<&Rare::value, LabelBlock>>("_setAccessibilityValueBlock:")
        .method<&storeRare<&Rare::isElement, FlagBlock>>("_setIsAccessibilityElementBlock:")
        .method<&storeRare<&Rare::activate, FlagBlock>>("_setAccessibilityActivateBlock:")
        .method<&ancestorOfKind>("_accessibilityAncestorIsKindOf:")
        .method<&labelForKeys>("_accessibilityStringForLabelKeyValues:")
        .method<&nothing<bool>>("_naturalIsAccessibilityElement")
        .method<&nothing<bool>>("_naturalAccessibilityActivate")
        .method<&nothing<id>>("_naturalAccessibilityLabel")
        .method<&nothing<id>>("_naturalAccessibilityValue")
        .method<&nothing<Traits>>("_naturalAccessibilityTraits")
        .method<&nothing<CGRect>>("_naturalAccessibilityFrame")
        .method<&nothing<id>>("_naturalAccessibilityElements")
        .method<&nothing<id>>("_naturalAccessibilityContainer");

bool elementIsElement(NSObject* /*self*/) { return true; }

const Registered elementClass =
    defineClass<UIAccessibilityElement, NSObject>()
        .method<&UIAccessibilityElement::initWithAccessibilityContainer>(
            "initWithAccessibilityContainer:")
        .method<&elementIsElement>("_naturalIsAccessibilityElement");

const Registered aggregateClass =
    defineClass<UIAccessibilityAggregateElement, UIAccessibilityElement>()
        .method<&UIAccessibilityAggregateElement::initWithContainerAndElements>(
            "initWithAccessibilityContainer:representedElements:")
        .method<&UIAccessibilityAggregateElement::naturalFrame>("_naturalAccessibilityFrame")
        .variable<&UIAccessibilityAggregateElement::representedElements>("_representedElements");

NotificationObserver& observer() {
  static NotificationObserver current;
  return current;
}

}  // namespace

id UIAccessibilityElement::initWithAccessibilityContainer(const id& container) {
  accessibilityAttributes(*this).container = Weak<>(container.get());
  return this;
}

Ref<UIAccessibilityElement> accessibilityElementWithContainer(const id& container) {
  auto element = make<UIAccessibilityElement>();
  return as<UIAccessibilityElement>(
      send<id>(element, "initWithAccessibilityContainer:", container));
}

id UIAccessibilityAggregateElement::initWithContainerAndElements(const id& container,
                                                                 const Ref<NSArray>& elements) {
  representedElements = elements;
  return initWithAccessibilityContainer(container);
}

CGRect UIAccessibilityAggregateElement::naturalFrame() {
  // Elements may represent each other, and each other's: while the outermost is asked, each of them
  // is asked once.
  struct Asked {
    id element;  // kept, so that its address stays its own
    std::optional<CGRect> frame;
  };
  thread_local std::unordered_map<const Object*, Asked> asked;
  const auto [known, isFirst] = asked.try_emplace(this, Asked{id(this), {}});
  if (!isFirst && !known->second.frame) {
    raise(kInternalInconsistencyException, "an element represents itself");
  }
  if (!isFirst) {
    return *known->second.frame;
  }
  const bool isOutermost = asked.size() == 1;
  const CGRect frame = UIAXFrameForElements(representedElements);
  asked[this].frame = frame;
  if (isOutermost) {
    asked.clear();
  }
  return frame;
}

void UIAccessibilityPostNotification(UIAccessibilityNotification notification, const id& argument) {
  if (const NotificationObserver current = observer()) {
    current(notification, argument);
  }
}

void setAccessibilityNotificationObserver(NotificationObserver current) {
  observer() = std::move(current);
}

bool UIAccessibilityIsScreenReaderRunning() { return Settings::current().screenReaderRuns; }

CGRect UIAccessibilityConvertFrameToScreenCoordinates(const CGRect& rect, const Ref<UIView>& view) {
  CGRect converted = rect;
  for (Ref<UIView> each = view; each; each = each->superview()) {
    const CGPoint scrolled = each->bounds().origin;
    converted.origin.x += each->frame().origin.x - scrolled.x;
    converted.origin.y += each->frame().origin.y - scrolled.y;
  }
  return converted;
}

}  // namespace tavro
