#include "platform/uikit/UITables.h"

#include <algorithm>

#include "platform/accessibility/Labels.h"
#include "platform/accessibility/Traversal.h"

namespace tavro {
namespace {

const Registered scrollClass = defineClass<UIScrollView, UIView>()
                                   .method<&UIScrollView::contentOffset>("contentOffset")
                                   .method<&UIScrollView::setContentOffset>("setContentOffset:");
const Registered tableClass = defineClass<UITableView, UIScrollView>();
const Registered cellViewClass =
    defineClass<UICellView, UIView>()
        .method<&UICellView::naturalIsElement>("_naturalIsAccessibilityElement")
        .method<&UICellView::naturalLabel>("_naturalAccessibilityLabel");
const Registered tableCellClass = defineClass<UITableViewCell, UICellView>()
                                      .method<&UITableViewCell::textLabel>("textLabel")
                                      .method<&UITableViewCell::detailTextLabel>("detailTextLabel")
                                      .method<&UITableViewCell::imageView>("imageView");
const Registered collectionCellClass = defineClass<UICollectionViewCell, UICellView>();
const Registered headerLabelClass = defineClass<UITableViewHeaderFooterViewLabel, UILabel>();

}  // namespace

void UITableView::appendRow(const Ref<UIView>& row, double height) {
  row->setFrame({0, nextY_, frame().size.width, height});
  nextY_ += height;
  addSubview(row);
}

bool UICellView::naturalIsElement() {
  if (trySend<id>(this, "accessibilityElements")) {
    return false;
  }
  // Asked by a cell that decides about itself, and may be this one: it looks for labels and
  // pictures, which this is not, so that it need not look inside. Else nested cells would multiply.
  thread_local bool isDeciding = false;
  if (isDeciding) {
    return !subviewList().empty();
  }
  struct Deciding {
    Deciding() { isDeciding = true; }
    ~Deciding() { isDeciding = false; }
  };
  const Deciding deciding;
  const std::vector<id> inside = accessibleDescendants(this);
  return !inside.empty() && std::ranges::all_of(inside, [](const id& element) {
    return isA<UILabel>(element.get()) || isA<UIImageView>(element.get());
  });
}

id UICellView::naturalLabel() {
  return naturalIsElement() ? UIAXStringForAllChildren(Ref<UIView>(this)) : id();
}

void UITableViewCell::setTextLabel(const Ref<UILabel>& label) {
  textLabel_ = label;
  addSubview(label);
}

void UITableViewCell::setDetailTextLabel(const Ref<UILabel>& label) {
  detailTextLabel_ = label;
  addSubview(label);
}

void UITableViewCell::setImageView(const Ref<UIImageView>& view) {
  imageView_ = view;
  addSubview(view);
}

}  // namespace tavro
