#include "platform/runtime/Message.h"

namespace tavro::message {
namespace {

std::string nameOf(const Object* receiver, Name selector) {
  const Class* const isa = receiver->isa();
  std::string name(isa->isMetaclass() ? "+[" : "-[");
  return name.append(isa->name().text()).append(" ").append(selector.text()).append("]");
}

// Made by a function of its own: when it is thrown, nothing is left for the unwinding to clean up.
NSException unknownSelector(const Object* receiver, Name selector) {
  return {kInvalidArgumentException, nameOf(receiver, selector) + ": unrecognized selector"};
}

}  // namespace

void raiseUnknownSelector(const Object* receiver, Name selector) {
  throw unknownSelector(receiver, selector);
}

void raiseWrongSignature(const Object* receiver, const Method& method, Signature called) {
  raise(kInvalidArgumentException, nameOf(receiver, method.selector) + ": has the signature " +
                                       std::string(method.signature.encodings) +
                                       " and was called as " + std::string(called.encodings));
}

void raiseWrongClass(const Object* object, Name expected) {
  raise(kInvalidArgumentException,
        "an object of class " + std::string(object->isa()->name().text()) + " stands where " +
            std::string(expected.text()) + " is needed");
}

}  // namespace tavro::message
