#include "platform/runtime/Exception.h"

namespace tavro {

NSException::NSException(std::string_view name, std::string_view reason)
    : name_(name), reason_(reason) {
  text_.reserve(name.size() + reason.size() + 2);
  text_.append(name).append(": ").append(reason);
}

NSException::~NSException() = default;

void raise(std::string_view name, std::string_view reason) { throw NSException(name, reason); }

}  // namespace tavro
