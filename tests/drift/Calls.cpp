#include "tests/drift/Calls.h"

#include "platform/foundation/NSValue.h"
#include "platform/uikit/UIView.h"

namespace tavro::drift {
namespace {

bool isMainThread() { return std::this_thread::get_id() == shared().mainThread; }

id withImpostorAt(const id& array, std::size_t index) {
  const auto original = as<NSArray>(array);
  if (!original || original->count() <= index) {
    return array;
  }
  std::vector<id> objects(original->begin(), original->end());
  // A number among numbers would be none.
  objects[index] = impostor(as<NSNumber>(objects[index]) ? Drift::aString : Drift::aNumber);
  return arrayWithObjects(std::move(objects));
}

/// The method that watches: the running one, or the category's that it was grafted from.
const Method* watchingMethod(const Object* receiver, const Method& running) {
  Class* const category = running.graftedFrom;
  return category == nullptr ? &running
                             : (receiver->isa()->isMetaclass() ? category->isa() : category)
                                   ->method(running.selector);
}

}  // namespace

Shared& shared() {
  static auto* const only = new Shared;
  return *only;
}

Recording* currentRecording() { return isMainThread() ? Recording::current : nullptr; }

id impostor(Drift drift) {
  switch (drift) {
    case Drift::aNumber:
      return number(std::int64_t{7});
    case Drift::aView:
      return makeView<UIView>();
    default:
      return string("drifted");
  }
}

id drifted(Drift drift, const id& answer) {
  switch (drift) {
    case Drift::nil:
      return nullptr;
    case Drift::aString:
    case Drift::aNumber:
    case Drift::aView:
      return impostor(drift);
    case Drift::wrongFirst:
      return withImpostorAt(answer, 0);
    case Drift::wrongLater:
      return withImpostorAt(answer, 1);
    default:
      return answer;
  }
}

Call::Call(Object* receiver, const Method& running)
    : receiver_(receiver),
      running_(running),
      outer_(shared().top),
      own_(watchingMethod(receiver, running)),
      watched_(shared().methods.at(own_)),
      isSeen_(isMainThread() && !watched_.isAttribute) {
  auto* const recording = currentRecording();
  if (recording != nullptr && watched_.isAttribute) {
    if (watched_.writes) {
      recording->leave(frameNow(), receiver, watched_.part);
    } else {
      recording->take(frameNow(), isUnderHost(), receiver, watched_.part);
    }
  }
  if (!isSeen_) {
    return;
  }
  if (recording != nullptr && watched_.isPlugin) {
    frame_ =
        recording->enter(frameNow(), receiver, isGraft() ? running.graftedFrom->name() : Name(),
                         isGraft() ? indexOfClass(running.owner->name()) : kNoMember);
  }
  shared().top = this;
}

Call::~Call() {
  if (isSeen_) {
    shared().top = outer_;
  }
}

Recording::Frame* Call::frameNow() {
  return shared().top == nullptr ? nullptr : shared().top->frame_;
}
bool Call::isUnderHost() { return shared().top != nullptr && shared().top->frame_ == nullptr; }

void Call::done(const id& answer) {
  Recording* const recording = currentRecording();
  if (frame_ != nullptr) {
    frame_->result = answer;
  }
  if (recording == nullptr || watched_.member == kNoMember || isPlatformsQuestion()) {
    return;
  }
  shared().top = outer_;  // what is noted now is noted by who called
  recording->read(frameNow(), isUnderHost(), watched_.member, answer);
  // What an object was told by a message may be in what it answers to another.
  if (frameNow() != nullptr && receiver_ != outer_->receiver_) {
    if (running_.signature.encodings.starts_with('v')) {
      recording->leave(frameNow(), receiver_, Part::told);
    } else {
      recording->take(frameNow(), false, receiver_, Part::told);
    }
  }
}

void Call::raised() {
  if (!isSeen_) {
    return;
  }
  if (!watched_.isPlugin) {
    for (Call* each = outer_; each != nullptr; each = each->outer_) {
      if (each->watched_.isPlugin && each->receiver_ == receiver_ &&
          each->running_.selector == running_.selector) {
        each->hostRaised_ = true;
        return;
      }
    }
    return;
  }
  const bool leavesPlugin = outer_ == nullptr || !outer_->watched_.isPlugin;
  if (!leavesPlugin || hostRaised_) {
    return;
  }
  std::string reason = "something";
  try {
    throw;
  } catch (const std::exception& error) {
    reason = error.what();
  } catch (...) {  // NOLINT(bugprone-empty-catch): it has no words
  }
  if (!isNoSuper(reason)) {
    shared().escaped.push_back(std::string(running_.selector.text()) + " of " +
                               std::string(receiver_->isa()->name().text()) + " let out " + reason);
  }
}

Drift Call::drift() const {
  return watched_.member == kNoMember
             ? Drift::none
             : shared().members[static_cast<std::size_t>(watched_.member)].drift;
}

/// The platform asks a host's object for its own answers; the plug-in has no part in that.
bool Call::isPlatformsQuestion() const {
  const std::string_view selector = running_.selector.text();
  return outer_ == nullptr &&
         (selector.starts_with("_natural") || selector.starts_with("accessibility"));
}

/// Whether what was raised says that the host has nothing to continue in, or nothing that fits.
bool Call::isNoSuper(const std::string& reason) const {
  const std::string selector = " " + std::string(running_.selector.text()) + "]: ";
  return reason.find(selector + "unrecognized selector") != std::string::npos ||
         reason.find(selector + "has the signature") != std::string::npos;
}

}  // namespace tavro::drift
