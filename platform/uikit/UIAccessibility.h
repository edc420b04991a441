#pragma once

#include <functional>
#include <memory>
#include <optional>

#include "platform/foundation/Geometry.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSString.h"

namespace tavro {

using UIAccessibilityTraits = std::uint64_t;
inline constexpr UIAccessibilityTraits UIAccessibilityTraitNone = 0;
inline constexpr UIAccessibilityTraits UIAccessibilityTraitButton = 1U << 0U;
inline constexpr UIAccessibilityTraits UIAccessibilityTraitHeader = 1U << 1U;
inline constexpr UIAccessibilityTraits UIAccessibilityTraitAdjustable = 1U << 2U;
inline constexpr UIAccessibilityTraits UIAccessibilityTraitSelected = 1U << 3U;
inline constexpr UIAccessibilityTraits UIAccessibilityTraitStaticText = 1U << 4U;
inline constexpr UIAccessibilityTraits UIAccessibilityTraitImage = 1U << 5U;

/// Marks a whole number of seconds, spoken as minutes and seconds.
inline constexpr Name UIAccessibilityTokenDurationTimeMMSS = "UIAccessibilityTokenDurationTimeMMSS";
/// Marks clock text ("1:02:03"), spoken as hours, minutes and seconds.
inline constexpr Name UIAccessibilityTokenDurationTimeHHMMSS =
    "UIAccessibilityTokenDurationTimeHHMMSS";

using LabelBlock = std::function<id()>;
using FlagBlock = std::function<bool()>;

/// What was set on an object for the screen reader. What was not set is answered by the class.
/// Every element of a chart has one, so what few objects need is kept apart.
struct AccessibilityAttributes {
  struct Rare {
    LabelBlock label;
    LabelBlock value;
    FlagBlock isElement;
    FlagBlock activate;
    id identification;
    std::optional<CGPoint> activationPoint;  ///< screen coordinates
  };

  id label;
  id value;
  id hint;
  Ref<NSArray> elements;
  Weak<> container;
  std::unique_ptr<Rare> rare;
  std::optional<UIAccessibilityTraits> traits;
  std::optional<CGRect> frame;  ///< screen coordinates, or those of the container's view
  bool frameIsInContainerSpace = false;
  std::optional<bool> isElement;
  std::optional<bool> viewIsVisible;
  bool elementsHidden = false;
  bool overridesInvisibility = false;
  bool viewIsModal = false;
  bool informationLoaded = false;
};

// Every object answers the accessibility attributes as messages. The answer is, in this order: what
// its override block yields (nil included), the value that was set, the natural answer of its
// class. Setting nil unsets; setting an empty text or no traits is a value.
//
//   isAccessibilityElement "B"     accessibilityLabel "@"      accessibilityValue "@"
//   accessibilityHint "@"          accessibilityTraits "Q"     accessibilityFrame (screen)
//   accessibilityPath "@"          accessibilityActivationPoint (screen)
//   accessibilityElements "@"      accessibilityContainer "@"  accessibilityViewIsModal "B"
//   accessibilityElementsHidden "B"  accessibilityIdentification "@"
//   accessibilityUserDefinedLabel "@": only a label that was set
//   accessibilityActivate "B"      accessibilityIncrement      accessibilityDecrement
//   and the setters of each: `setAccessibilityLabel:`, `setIsAccessibilityElement:`, ...
//
// The runtime's own: _accessibilityAddTrait:, _accessibilitySetOverridesInvisibility:,
// _accessibilitySetViewIsVisible:, _accessibilityViewIsVisible, _accessibilityExpandedStatus "q"
// (0 none, 1 expanded, 2 collapsed), _accessibilityHitTest:withEvent:, the load hook
// _accessibilityLoadAccessibilityInformation, and the override blocks
// _setAccessibilityLabelBlock:, _setAccessibilityValueBlock:, _setIsAccessibilityElementBlock:,
// _setAccessibilityActivateBlock:. A block holds objects weakly; an empty block removes it.
//
// Natural answers, for classes to supply: _naturalIsAccessibilityElement "B",
// _naturalAccessibilityLabel "@", _naturalAccessibilityValue "@", _naturalAccessibilityTraits "Q",
// _naturalAccessibilityFrame, _naturalAccessibilityElements "@", _naturalAccessibilityContainer
// "@", _naturalAccessibilityActivate "B".

/// The object's attributes, made when absent.
AccessibilityAttributes& accessibilityAttributes(NSObject& object);

/// An element that stands for something drawn. Its list holds it; it holds its container weakly.
class UIAccessibilityElement : public NSObject {
 public:
  static constexpr Name className = "UIAccessibilityElement";

  /// `initWithAccessibilityContainer:`
  id initWithAccessibilityContainer(const id& container);
};

/// A new element whose container is that object.
Ref<UIAccessibilityElement> accessibilityElementWithContainer(const id& container);

/// An element that stands for several: its frame is the union of theirs.
class UIAccessibilityAggregateElement : public UIAccessibilityElement {
 public:
  static constexpr Name className = "UIAccessibilityAggregateElement";

  Ref<NSArray> representedElements;

  /// `initWithAccessibilityContainer:representedElements:`
  id initWithContainerAndElements(const id& container, const Ref<NSArray>& elements);
  CGRect naturalFrame();
};

enum class UIAccessibilityNotification : std::int64_t { layoutChanged, screenChanged };
inline constexpr auto UIAccessibilityLayoutChangedNotification =
    UIAccessibilityNotification::layoutChanged;
inline constexpr auto UIAccessibilityScreenChangedNotification =
    UIAccessibilityNotification::screenChanged;

/// Tells whoever observes; the argument is the element to move to, or nil.
void UIAccessibilityPostNotification(UIAccessibilityNotification notification, const id& argument);
using NotificationObserver = std::function<void(UIAccessibilityNotification, const id&)>;
/// The one observer, the screen reader; an empty function removes it.
void setAccessibilityNotificationObserver(NotificationObserver observer);

/// Whether the screen reader runs, at this moment.
bool UIAccessibilityIsScreenReaderRunning();

class UIView;
/// A rectangle of a view's own coordinates in screen coordinates; unchanged for a nil view.
CGRect UIAccessibilityConvertFrameToScreenCoordinates(const CGRect& rect, const Ref<UIView>& view);

/// Sends the load hook once to every view and controller below a view that is on screen now.
/// Called by views when they appear; an exception of one object does not keep the others from it.
void loadAccessibilityInformation(UIView& view);
/// Counts everything at and below a view as never loaded.
void forgetAccessibilityInformation(UIView& view);
/// Sends the load hook again to everything on screen: after an installation, or when the screen or
/// the language changed.
void reloadAccessibilityInformation();

}  // namespace tavro
