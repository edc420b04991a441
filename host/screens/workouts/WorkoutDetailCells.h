#pragma once

#include "platform/healthkit/HKWorkout.h"
#include "platform/uikit/UITables.h"

namespace tavro {

/// A workout's average pace, for cycling its average speed. Message:
/// `configureWithWorkout:workoutActivity:dataCalculator:`.
class CHWorkoutDetailPaceTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHWorkoutDetailPaceTableViewCell";
  static constexpr double height = 56;

  Ref<UILabel> _titleLabel;
  Ref<UILabel> _valueLabel;

  /// Makes the cell's parts.
  id init();
  /// The calculator answers `averagePaceForWorkout:`; the activity may be nil.
  void configureWithWorkout(const Ref<HKWorkout>& workout, const id& activity,
                            const id& dataCalculator);
  void layoutSubviews();
};

/// One split: its unit, its length where it is not a whole unit, and its pace.
class CHWorkoutDetailSplitTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHWorkoutDetailSplitTableViewCell";
  static constexpr double height = 36;

  Ref<UILabel> _unitLabel;
  Ref<UILabel> _distanceLabel;
  Ref<UILabel> _paceLabel;

  /// Makes the cell's parts.
  id init();
  /// The number counts from 1. Metres and seconds.
  void setSplit(std::size_t number, double distance, double duration);
  void layoutSubviews();
};

/// Two figures side by side, each a title above its value, an attributed string. Messages:
/// `configureWithTitle1:value1:`, `configureWithTitle2:value2:`.
class CHWorkoutDetailTwoValueTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHWorkoutDetailTwoValueTableViewCell";
  static constexpr double height = 64;

  Ref<UILabel> _titleLabel1;
  Ref<UILabel> _valueLabel1;
  Ref<UILabel> _titleLabel2;
  Ref<UILabel> _valueLabel2;

  /// Makes the cell's parts.
  id init();
  void configureWithTitle1(const Ref<NSString>& title, const id& value);
  void configureWithTitle2(const Ref<NSString>& title, const id& value);
  void layoutSubviews();
};

/// Heads a section of rows that its button shows and hides. The rows below move up meanwhile.
class CHWorkoutDetailExpandingHeaderView : public UIView {
 public:
  static constexpr Name className = "CHWorkoutDetailExpandingHeaderView";
  static constexpr double height = 44;

  Ref<UILabel> _titleLabel;
  Ref<UIButton> _expandButton;
  bool _expanded = true;

  /// Makes the header's parts.
  id init();
  void setTitle(std::string_view title) { _titleLabel->setText(string(title)); }
  /// A row of the section; it stands in the header's table.
  void addRow(const Ref<UIView>& row) { rows_.push_back(row); }
  void setExpanded(bool expanded);
  void layoutSubviews();

 private:
  std::vector<Ref<UIView>> rows_;
};

}  // namespace tavro
