#pragma once

#include <functional>

#include "platform/uikit/UIView.h"

namespace tavro {

/// Text. Naturally an element that says its text. Messages: `text`, `setText:`, `attributedText`,
/// `setAttributedText:`.
class UILabel : public UIView {
 public:
  static constexpr Name className = "UILabel";

  /// The text shown, without its attributes; nil when there is none.
  [[nodiscard]] Ref<NSString> text() const { return text_; }
  void setText(const Ref<NSString>& text);
  [[nodiscard]] id attributedText() const { return attributedText_; }
  /// Shows the text of an attributed string.
  void setAttributedText(const id& text);

  bool naturalIsElement() { return true; }
  id naturalLabel() { return text_; }
  UIAccessibilityTraits naturalTraits() { return UIAccessibilityTraitStaticText; }

 private:
  Ref<NSString> text_;
  id attributedText_;
};

/// A picture in memory; carries what is set on it, nothing by nature.
class UIImage : public NSObject {
 public:
  static constexpr Name className = "UIImage";
  std::string name;
};

/// Shows a picture. Not an element unless made one. Messages: `image`, `setImage:`.
class UIImageView : public UIView {
 public:
  static constexpr Name className = "UIImageView";

  [[nodiscard]] Ref<UIImage> image() const { return image_; }
  void setImage(const Ref<UIImage>& image) { image_ = image; }

  UIAccessibilityTraits naturalTraits() { return UIAccessibilityTraitImage; }

 private:
  Ref<UIImage> image_;
};

/// A view that acts when it is tapped.
class UIControl : public UIView {
 public:
  static constexpr Name className = "UIControl";

  /// What a tap does; replaces the earlier action.
  void setAction(std::function<void()> action) { action_ = std::move(action); }
  /// Does what a tap does; NO when there is no action.
  bool sendAction();
  bool naturalActivate() { return sendAction(); }

 private:
  std::function<void()> action_;
};

/// Naturally an element that says its title, a button. Messages: `title`, `setTitle:`.
class UIButton : public UIControl {
 public:
  static constexpr Name className = "UIButton";

  [[nodiscard]] Ref<NSString> title() const { return title_; }
  void setTitle(const Ref<NSString>& title) { title_ = title; }

  bool naturalIsElement() { return true; }
  id naturalLabel() { return title_; }
  UIAccessibilityTraits naturalTraits() { return UIAccessibilityTraitButton; }

 private:
  Ref<NSString> title_;
};

/// A new label with that text.
Ref<UILabel> makeLabel(std::string_view text, CGRect frame = {});

}  // namespace tavro
