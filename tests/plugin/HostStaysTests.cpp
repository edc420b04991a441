#include <sstream>

#include "platform/foundation/NSAttributedString.h"
#include "reader/Session.h"
#include "reader/SummaryDescription.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

/// What an application shows of itself, view by view.
void describe(const Ref<UIView>& view, std::ostream& into) {
  const CGRect frame = view->frame();
  into << view->isa()->name().text() << " " << frame.origin.x << "," << frame.origin.y << ","
       << frame.size.width << "," << frame.size.height << " " << view->bounds().origin.x << ","
       << view->bounds().origin.y << " " << view->alpha() << view->isHidden();
  for (const Name text : {Name("text"), Name("attributedText"), Name("title")}) {
    into << " \"" << utf8(plainText(trySend<id>(view, text))) << "\"";
  }
  into << " layers " << view->layer()->sublayers()->count() << " (\n";
  for (const Ref<UIView>& child : view->subviewList()) {
    describe(child, into);
  }
  into << ")\n";
}

std::string shownBy(Session& session) {
  std::ostringstream all;
  for (const std::string_view screen : Application::screenNames()) {
    static_cast<void>(session.read(screen));
    describe(Ref<UIView>(&session.application().window()), all);
  }
  return all.str();
}

TEST(HostStays, WhatIsShownIsTheSameWithThePlugin) {
  SessionOptions options;
  options.diary = TAVRO_SAMPLE_DIARY;
  options.bundle = bundlePath();
  options.reader = std::string(TAVRO_SOURCE) + "/reader/resources";
  options.withPlugin = false;
  Session session(options);
  const std::string alone = shownBy(session);
  letSummariesDescribeRings(loadAccessibilityBundle(bundlePath()));
  EXPECT_EQ(shownBy(session), alone);
}

}  // namespace
}  // namespace tavro
