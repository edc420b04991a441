#pragma once

#include <map>
#include <set>
#include <string>
#include <vector>

#include "platform/accessibility/BundleLoader.h"
#include "platform/runtime/Message.h"

namespace tavro::drift {

/// How a member of the host may differ from what the plug-in was written for.
enum class Drift {
  none,
  missing,
  otherType,   ///< another result type, or a variable of another type
  raises,      ///< the method raises
  nil,         ///< answers nil
  aString,     ///< answers an object of another class: a string,
  aNumber,     ///< ... a number,
  aView,       ///< ... a view of no special class
  wrongFirst,  ///< the answered array begins with an object of another class
  wrongLater,  ///< ... holds one as its second element
};
inline constexpr int kDrifts = 10;
std::string_view textOf(Drift drift);

/// A class of the host, or one member of one: what can drift.
struct Member {
  enum class Sort { wholeClass, method, classMethod, variable };

  Sort sort = Sort::wholeClass;
  Class* owner = nullptr;  ///< never the metaclass
  Name name = {};
  /// A method's result and arguments, or a variable's type.
  std::string_view type = {};
  bool isObject = false;  ///< a variable that holds an object, or a method that answers one
  Drift drift = Drift::none;

  /// "CHRow", "-[CHRow label]", "+[CHCache sharedInstance]", "CHRow._label"
  [[nodiscard]] std::string text() const;
};

/// Every class and member of the host, once `watchHost` has found them; an index names one.
std::vector<Member>& members();
constexpr int kNoMember = -1;
int indexOfClass(Name name);

/// Puts a watching method in the place of each method of the host and of the plug-in's categories,
/// and a watching address in that of each variable. Called once, after the bundle was opened and
/// before it is initialised. `checked` names members of the
/// platform that are checked as the host's are: "HKSource _isOrlamWatch".
void watchHost(const LoadedBundle& bundle, const std::set<std::string>& checked);
/// Signatures that no watching method is made for; empty when every method is watched.
const std::vector<std::string>& unwatchedSignatures();

/// Makes a member drift for the rest of the process. A missing class stays there for the host
/// itself, which makes its instances; whoever else looks for it finds nothing.
void makeDrift(int member, Drift drift);
/// While it is set, everybody counts as a stranger who looks for a missing class: the time in which
/// the plug-in is checked and installed.
void setInstalling(bool installing);

/// Exceptions that left the plug-in although the host's own method had not raised.
const std::vector<std::string>& escapedExceptions();

/// The objects that were made since the watch began and live now, by class.
std::map<std::string, int> liveObjects();

}  // namespace tavro::drift
