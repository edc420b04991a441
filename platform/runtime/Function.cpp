#include "platform/runtime/Function.h"

namespace tavro {
namespace {

const Registered functions = ClassBuilder({.name = kFunctions});

}  // namespace
}  // namespace tavro
