#pragma once

#include <link.h>

#include <thread>
#include <unordered_map>

#include "tests/drift/Recording.h"

namespace tavro::drift {

/// A watched method: what stands behind it, and why it is watched.
struct Watched {
  int member = kNoMember;
  bool isPlugin = false;
  bool isAttribute = false;
  Part part = label;
  bool writes = false;
};

class Call;

/// What the watching code shares.
struct Shared {
  std::vector<Member> members;
  std::unordered_map<std::uint64_t, int> classes;
  std::unordered_map<const Method*, Watched> methods;
  std::vector<InstanceVariable> variables;
  std::vector<int> variableMembers;
  std::vector<std::string> unwatched;
  std::vector<std::string> escaped;
  Call* top = nullptr;
  std::vector<std::uint64_t> missing;
  bool installing = false;
  std::thread::id mainThread = std::this_thread::get_id();
  ElfW(Addr) pluginStart = 0;
  ElfW(Addr) pluginEnd = 0;
};

Shared& shared();
/// The one that takes notes of this thread. The health store is asked on another thread, which is
/// not watched.
Recording* currentRecording();

/// A new object that stands where another class was expected.
id impostor(Drift drift);
/// What a member that drifts answers in place of its answer.
id drifted(Drift drift, const id& answer);

/// One call of a watched method while it runs.
class Call {
 public:
  Call(Object* receiver, const Method& running);
  ~Call();
  Call(const Call&) = delete;
  Call& operator=(const Call&) = delete;

  void done(const id& answer);
  /// The host's own method may raise through the category that continues in it; nothing else may.
  void raised();

  [[nodiscard]] Drift drift() const;
  /// The code that is watched, and what it is told to be running: a category's method continues
  /// from its graft.
  [[nodiscard]] Implementation code() const { return own_->replaced->implementation; }
  [[nodiscard]] const Method& told() const { return isGraft() ? running_ : *own_->replaced; }

  /// The innermost running call's frame, and whether that call is the host's.
  static Recording::Frame* frameNow();
  static bool isUnderHost();

 private:
  [[nodiscard]] bool isGraft() const { return running_.graftedFrom != nullptr; }
  [[nodiscard]] bool isPlatformsQuestion() const;
  [[nodiscard]] bool isNoSuper(const std::string& reason) const;

  Object* receiver_;
  const Method& running_;
  Call* outer_;
  const Method* own_;  ///< the watching method, of the category where it is grafted
  Watched watched_;
  Recording::Frame* frame_ = nullptr;
  bool isSeen_ = false;
  bool hostRaised_ = false;
};

/// The watching code for methods of one signature.
struct Shape {
  Signature signature;
  Implementation watch;
  Signature otherSignature;
  Implementation answerOtherType;
};
/// nullptr for a signature that no method is known to have.
const Shape* shapeOf(Signature signature);

}  // namespace tavro::drift
