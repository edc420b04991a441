#pragma once

#include <array>
#include <deque>
#include <map>
#include <nlohmann/json.hpp>
#include <set>

#include "platform/accessibility/Traversal.h"
#include "tests/drift/Members.h"

namespace tavro::drift {

/// What an element says, in the parts that can change each on its own; whether it is there; and,
/// for objects that are no elements, what they were told.
enum Part { label, value, hint, traits, status, presence, told };
inline constexpr int kParts = 5;  ///< those that are said

/// Of an element: which of its parts may change when a member drifts.
using PartMask = unsigned;
inline constexpr PartMask kPresence = 1U << presence;

/// What one screen's elements depend on, recorded while the undisturbed plug-in answers.
///
/// Each call of a plug-in's method is a *frame*: what it reads of the host, and on which objects it
/// leaves accessibility attributes. A part of an element depends on what was read while it was
/// asked, on what frames had read that left an attribute which was taken up then, and so on. That
/// an element is there depends on the reads that answered it or what it lies in; on those of the
/// frames that said whether it is an element; and, for an element that the plug-in makes, on all
/// reads of the frames that made the list it is in.
class Recording {
 public:
  enum class Phase { building, walking, asking, gesturing };

  /// The one that takes notes, or nullptr.
  static Recording* current;

  struct Frame {
    Frame* parent = nullptr;
    id receiver;
    Name category;
    bool walking = false;
    struct Read {
      int member;
      id value;
      bool isOwnClass = false;  ///< the class whose category runs
    };
    struct Touched {
      id object;
      Part part;
    };
    std::vector<Read> reads;
    std::vector<Touched> taken;
    std::vector<Touched> left;
    std::vector<Frame*> children;
    id result;
  };

  Frame* enter(Frame* parent, Object* receiver, Name category, int ownClass);
  /// The frame is nullptr when no plug-in method is directly at work.
  void read(Frame* frame, bool underHost, int member, const id& value);
  void take(Frame* frame, bool underHost, Object* object, Part part);
  void leave(Frame* frame, Object* object, Part part);

  void setPhase(Phase phase) {
    phase_ = phase;
    asking_ = nullptr;
  }
  /// What is read until the next call is read for this part of that element.
  void ask(std::size_t element, Part part);
  void setElements(const std::vector<AccessibleElement>& elements);

  struct Dependency {
    PartMask parts = 0;
    /// For a member that answers the elements in an array: the element's place in it.
    int place = -1;
    /// What the member itself has to say, by the parts that it is said in.
    std::map<int, std::set<std::string>> texts;
  };
  /// By element, then by member.
  [[nodiscard]] std::vector<std::map<int, Dependency>> dependencies();
  /// The members that the plug-in read in any way, gestures included: what they answered, and which
  /// categories read them.
  struct Reads {
    std::set<std::string> answers;
    std::set<std::string> categories;
  };
  [[nodiscard]] std::map<int, Reads> membersRead() const;

 private:
  using Chain = std::set<const Object*>;
  using Members = std::map<int, Dependency>;

  Frame* sink(Frame* frame, bool underHost);
  [[nodiscard]] Chain chainOf(const AccessibleElement& element) const;
  [[nodiscard]] bool isAudible(const id& object) const;
  [[nodiscard]] bool isBeside(const id& object, const id& element) const;
  void collect(const Frame& frame, std::set<const Frame*>& visited, bool audibleOnly,
               std::vector<const Frame::Read*>& into) const;
  void collectAbove(const Frame& frame, std::vector<const Frame::Read*>& into) const;
  void addPresence(const AccessibleElement& element, const Chain& chain, Members& members) const;

  Phase phase_ = Phase::building;
  std::deque<Frame> frames_;
  std::map<std::pair<std::size_t, Part>, Frame*> asked_;
  Frame* asking_ = nullptr;
  std::vector<AccessibleElement> elements_;
  std::vector<Chain> chains_;
};

}  // namespace tavro::drift
