#pragma once

#include <string>

#include "platform/uikit/UIControls.h"

namespace tavro {

/// A person who shares activity with the user.
class ASFriend : public NSObject {
 public:
  static constexpr Name className = "ASFriend";

  std::string name;
  bool hasNews = false;
  bool isCompeting = false;
};

/// Draws how a competition stands, and says it: the library that draws it made it accessible.
class ASCompetitionScoreView : public UIView {
 public:
  static constexpr Name className = "ASCompetitionScoreView";

  /// Makes the labels.
  id init();
  void setScores(double mine, std::string_view friendName, double theirs);

  void layoutSubviews();
  bool naturalIsElement() { return true; }
  /// "You 1,284, Ines 1,320".
  id naturalLabel();

 private:
  Ref<UILabel> myLabel_;
  Ref<UILabel> friendLabel_;
};

}  // namespace tavro
