#pragma once

#include "platform/uikit/UIControls.h"

namespace tavro {

/// A view whose content is larger than itself. Messages: `contentOffset`, `setContentOffset:`.
class UIScrollView : public UIView {
 public:
  static constexpr Name className = "UIScrollView";

  [[nodiscard]] CGPoint contentOffset() const { return bounds().origin; }
  void setContentOffset(CGPoint offset) { setBoundsOrigin(offset); }
};

/// A column of rows, laid out from the top in the order in which they were added.
class UITableView : public UIScrollView {
 public:
  static constexpr Name className = "UITableView";

  /// Adds a row or a section header of that height, as wide as the table.
  void appendRow(const Ref<UIView>& row, double height);

 private:
  double nextY_ = 0;
};

/// What table and collection cells share: naturally one element that says its labels, when it has
/// no element list of its own and holds nothing but labels and pictures.
class UICellView : public UIView {
 public:
  static constexpr Name className = "__UICellView";

  bool naturalIsElement();
  id naturalLabel();
};

/// Messages: `textLabel`, `detailTextLabel`, `imageView`; each nil until the cell has one.
class UITableViewCell : public UICellView {
 public:
  static constexpr Name className = "UITableViewCell";

  [[nodiscard]] Ref<UILabel> textLabel() const { return textLabel_; }
  [[nodiscard]] Ref<UILabel> detailTextLabel() const { return detailTextLabel_; }
  [[nodiscard]] Ref<UIImageView> imageView() const { return imageView_; }
  /// Each becomes a subview of the cell.
  void setTextLabel(const Ref<UILabel>& label);
  void setDetailTextLabel(const Ref<UILabel>& label);
  void setImageView(const Ref<UIImageView>& view);

 private:
  Ref<UILabel> textLabel_;
  Ref<UILabel> detailTextLabel_;
  Ref<UIImageView> imageView_;
};

class UICollectionViewCell : public UICellView {
 public:
  static constexpr Name className = "UICollectionViewCell";
};

/// The label of a table's section header.
class UITableViewHeaderFooterViewLabel : public UILabel {
 public:
  static constexpr Name className = "_UITableViewHeaderFooterViewLabel";
};

}  // namespace tavro
