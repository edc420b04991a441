#include "platform/foundation/NSObject.h"

#include "platform/foundation/NSString.h"

namespace tavro {

NSObject::NSObject() = default;
NSObject::~NSObject() = default;

namespace {

/// What `alloc` on the root class itself makes.
class PlainObject final : public NSObject {};

id allocated(Class* isa) { return isa->allocate(); }

// Messages, not calls: a subclass or a category may have its own `alloc` and `init`.
id created(Class* isa) { return send<id>(send<id>(isa, "alloc"), "init"); }

// A class object inherits these too, so the receiver is not always an NSObject.
id initialized(Object* self) { return self; }
Ref<NSString> description(Object* self) { return string(self->isa()->name().text()); }
bool isKindOfClass(Object* self, Class* isa) { return isKindOf(self, isa); }
bool respondsToSelector(Object* self, Name selector) { return respondsTo(self, selector); }

const Registered kObject = ClassBuilder({.name = NSObject::className,
                                         .create = []() -> Object* { return new PlainObject; }})
                               .classMethod<&allocated>("alloc")
                               .classMethod<&created>("new")
                               .method<&initialized>("init")
                               .method<&description>("description")
                               .method<&isKindOfClass>("isKindOfClass:")
                               .method<&respondsToSelector>("respondsToSelector:");

}  // namespace
}  // namespace tavro
