#include "tests/drift/Recording.h"

#include <algorithm>

#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/NSValue.h"
#include "platform/uikit/UIView.h"
#include "reader/Utterance.h"

namespace tavro::drift {
namespace {

/// Classes of which it is decided that some things are said together or not at all, so that what
/// lacks one member lacks the others' words too.
constexpr Name kSaidTogether[] = {
    "CHWorkoutDetailTwoValueTableViewCell",   // both pairs: half a row would mislead
    "CHASActivitySetupGoalView",              // a number and its unit
    "_CHWorkoutSummaryTabbedLabelContainer",  // a figure and the header that names it
};

bool isSaidTogether(int member) {
  const Class* const owner = members()[static_cast<std::size_t>(member)].owner;
  return std::ranges::count(kSaidTogether, owner->name()) > 0;
}

bool isMember(const std::set<const Object*>& chain, const id& object) {
  return chain.contains(object.get());
}

/// The place in an array of what leads to an element; -1 without one.
int placeIn(const id& array, const std::set<const Object*>& chain) {
  if (const auto list = as<NSArray>(array)) {
    const auto found =
        std::ranges::find_if(*list, [&](const id& each) { return isMember(chain, each); });
    return found == list->end() ? -1 : static_cast<int>(found - list->begin());
  }
  return -1;
}

bool holds(const id& value, const std::set<const Object*>& chain) {
  return value && (isMember(chain, value) || placeIn(value, chain) >= 0);
}

bool isMadeByPlugin(const AccessibleElement& element) {
  return isA<UIAccessibilityElement>(element.element.get());
}

std::string kindOf(const id& answer) {
  return !answer                ? "nil"
         : as<NSArray>(answer)  ? "array"
         : as<NSString>(answer) ? "string"
         : as<NSNumber>(answer) ? "number"
                                : "object";
}

/// What an answer of the host says as it is.
std::string textOf(const id& answer) {
  const bool isText = as<NSString>(answer) || as<NSAttributedString>(answer);
  return spokenText(isText ? answer : trySend<id>(answer, "accessibilityLabel"));
}

void add(std::map<int, Recording::Dependency>& members, int member, PartMask parts, int place) {
  auto& entry = members[member];
  if ((parts & kPresence) != 0) {
    const bool isFirst = (entry.parts & kPresence) == 0;
    entry.place = isFirst || entry.place == place ? place : -1;
  }
  entry.parts |= parts;
}

}  // namespace

Recording* Recording::current = nullptr;

Recording::Frame* Recording::enter(Frame* parent, Object* receiver, Name category, int ownClass) {
  Frame& frame = frames_.emplace_back();
  frame.parent = parent;
  frame.receiver = id(receiver);
  frame.category = category;
  frame.walking = phase_ == Phase::walking;
  if (ownClass != kNoMember) {
    frame.reads.push_back({ownClass, nullptr, true});
  }
  if (parent != nullptr) {
    parent->children.push_back(&frame);
  } else if (asking_ != nullptr) {
    asking_->children.push_back(&frame);
  }
  return &frame;
}

Recording::Frame* Recording::sink(Frame* frame, bool underHost) {
  return frame == nullptr && !underHost ? asking_ : frame;
}

void Recording::read(Frame* frame, bool underHost, int member, const id& value) {
  if (Frame* const into = sink(frame, underHost); into != nullptr && member != kNoMember) {
    into->reads.push_back({member, value, false});
  }
}

void Recording::take(Frame* frame, bool underHost, Object* object, Part part) {
  if (Frame* const into = sink(frame, underHost)) {
    into->taken.push_back({id(object), part});
  }
}

void Recording::leave(Frame* frame, Object* object, Part part) {
  if (frame != nullptr) {
    frame->left.push_back({id(object), part});
  }
}

void Recording::ask(std::size_t element, Part part) {
  phase_ = Phase::asking;
  asking_ = asked_[{element, part}] = &frames_.emplace_back();
}

Recording::Chain Recording::chainOf(const AccessibleElement& element) const {
  constexpr int deepest = 50;
  Chain chain;
  for (const id& container : element.containers) {
    chain.insert(container.get());
  }
  id each = element.element;
  for (int depth = 0; each && depth < deepest; ++depth) {
    chain.insert(each.get());
    each = trySend<id>(each, "accessibilityContainer");
  }
  if (const auto group = as<UIAccessibilityAggregateElement>(element.element)) {
    for (const id& represented : *group->representedElements) {
      chain.insert(represented.get());
    }
  }
  return chain;
}

bool Recording::isAudible(const id& object) const {
  return std::ranges::any_of(chains_, [&](const Chain& chain) { return holds(object, chain); });
}

/// Whether an object is a view that is not heard itself, lies outside an element and lends it its
/// words: it may be heard in its own place when it cannot be found.
bool Recording::isBeside(const id& object, const id& element) const {
  if (!as<UIView>(object) || isAudible(object)) {
    return false;
  }
  return !chainOf({object, {}}).contains(element.get());
}

/// All that a frame's answer and what it left rest on: its own reads, those of the frames that left
/// what it took up, and those of the frames within it. A frame within it that answered elements
/// passes on which elements, not what they say.
void Recording::collect(const Frame& frame, std::set<const Frame*>& visited, bool audibleOnly,
                        std::vector<const Frame::Read*>& into) const {
  if (!visited.insert(&frame).second) {
    return;
  }
  for (const Frame::Read& read : frame.reads) {
    if (!audibleOnly || isAudible(read.value)) {
      into.push_back(&read);
    }
  }
  for (const Frame* const child : frame.children) {
    collect(*child, visited, audibleOnly || isAudible(child->result), into);
  }
  if (audibleOnly) {
    return;
  }
  for (const Frame::Touched& taken : frame.taken) {
    for (const Frame& other : frames_) {
      const bool left = std::ranges::any_of(other.left, [&](const Frame::Touched& each) {
        return each.object == taken.object && each.part == taken.part;
      });
      if (left) {
        collect(other, visited, false, into);
        collectAbove(other, into);
      }
    }
  }
}

/// What decided whether a frame was entered.
void Recording::collectAbove(const Frame& frame, std::vector<const Frame::Read*>& into) const {
  for (const Frame* above = frame.parent; above != nullptr; above = above->parent) {
    for (const Frame::Read& read : above->reads) {
      into.push_back(&read);
    }
  }
}

void Recording::addPresence(const AccessibleElement& element, const Chain& chain,
                            Members& members) const {
  for (const Frame& frame : frames_) {
    const bool answered = frame.walking && isMember(chain, frame.receiver);
    bool placed = false;
    bool decided = false;
    for (const Frame::Touched& each : frame.left) {
      placed = placed || (each.part == presence && isMember(chain, each.object));
      decided = decided || (each.part == presence && each.object == element.element);
    }
    if (!answered && !placed) {
      continue;
    }
    std::vector<const Frame::Read*> reads;
    std::set<const Frame*> visited;
    collect(frame, visited, false, reads);
    if (placed) {
      collectAbove(frame, reads);
    }
    for (const Frame::Read* const read : reads) {
      const Member& member = drift::members()[static_cast<std::size_t>(read->member)];
      const bool isClass = member.sort == Member::Sort::wholeClass;
      const bool isOfClass = read->isOwnClass || isKindOf(element.element.get(), member.owner);
      const bool counts = isAudible(read->value)
                              ? holds(read->value, chain) || isSaidTogether(read->member)
                          : isMadeByPlugin(element) ? true
                          : isClass                 ? isOfClass
                                                    : decided;
      if (counts) {
        add(members, read->member, kPresence, placeIn(read->value, chain));
      }
    }
  }
}

std::vector<std::map<int, Recording::Dependency>> Recording::dependencies() {
  current = nullptr;  // what is asked here is no answer to the reader
  std::vector<Members> all;
  for (std::size_t index = 0; index < elements_.size(); ++index) {
    Members& members = all.emplace_back();
    for (int part = 0; part < kParts; ++part) {
      const auto asked = asked_.find({index, static_cast<Part>(part)});
      if (asked != asked_.end()) {
        std::vector<const Frame::Read*> reads;
        std::set<const Frame*> visited;
        collect(*asked->second, visited, false, reads);
        for (const Frame::Read* const read : reads) {
          const PartMask own = 1U << static_cast<unsigned>(part);
          const bool mayBeHeard = isBeside(read->value, elements_[index].element);
          add(members, read->member, mayBeHeard ? own | kPresence : own, -1);
          const bool isOwnText = !isSaidTogether(read->member);
          members[read->member].texts[part].insert(isOwnText ? textOf(read->value) : "");
        }
      }
    }
    addPresence(elements_[index], chains_[index], members);
  }
  current = this;
  return all;
}

std::map<int, Recording::Reads> Recording::membersRead() const {
  std::map<int, Reads> found;
  for (const Frame& frame : frames_) {
    for (const Frame::Read& read : frame.reads) {
      found[read.member].answers.insert(kindOf(read.value));
      found[read.member].categories.emplace(frame.category.text());
    }
  }
  return found;
}

void Recording::setElements(const std::vector<AccessibleElement>& elements) {
  elements_ = elements;
  std::ranges::transform(elements_, std::back_inserter(chains_),
                         [this](const AccessibleElement& each) { return chainOf(each); });
}

}  // namespace tavro::drift
