#include "platform/runtime/Exception.h"

namespace tavro {

NSException::NSException(std::string_view name, std::string_view reason)
    : name_(name), reason_(reason), text_(name_ + ": " + reason_) {}

NSException::~NSException() = default;

void raise(std::string_view name, std::string_view reason) { throw NSException(name, reason); }

}  // namespace tavro
