#include <algorithm>

#include "platform/uikit/UIView.h"
#include "tests/drift/Calls.h"

namespace tavro::drift {
namespace {

template <class R, class... A>
struct ShapeOf {
  using Code = R (*)(Object*, const Method&, A...);
  using Other = std::conditional_t<std::is_same_v<R, id>, std::int64_t, id>;

  static R watch(Object* receiver, const Method& running, A... arguments) {
    Call call(receiver, running);
    try {
      if (call.drift() == Drift::raises) {
        raise(kInternalInconsistencyException, "drifted");
      }
      const auto code = reinterpret_cast<Code>(call.code());
      if constexpr (std::is_void_v<R>) {
        code(receiver, call.told(), arguments...);
        call.done(nullptr);
      } else if constexpr (std::is_same_v<R, id>) {
        R answer = drifted(call.drift(), code(receiver, call.told(), arguments...));
        call.done(answer);
        return answer;
      } else {
        R answer = code(receiver, call.told(), arguments...);
        call.done(nullptr);
        return answer;
      }
    } catch (...) {
      call.raised();
      throw;
    }
  }

  static Other answerOtherType(Object* /*receiver*/, const Method& /*running*/,
                               A... /*arguments*/) {
    if constexpr (std::is_same_v<R, id>) {
      return 7;
    } else {
      return impostor(Drift::aString);
    }
  }
};

template <class R, class... A>
Shape shape() {
  using Code = ShapeOf<R, A...>;
  return {kSignature<R, A...>, reinterpret_cast<Implementation>(&Code::watch),
          kSignature<typename Code::Other, A...>,
          reinterpret_cast<Implementation>(&Code::answerOtherType)};
}

}  // namespace

const Shape* shapeOf(Signature signature) {
  using O = Object*;
  using Q = std::int64_t;
  static const Shape shapes[] = {
      shape<id>(),
      shape<id, O>(),
      shape<id, O, O>(),
      shape<id, O, O, O>(),
      shape<id, Q>(),
      shape<id, Q, O>(),
      shape<id, std::uint64_t>(),
      shape<id, CGPoint, O>(),
      shape<id, O, double>(),
      shape<id, id*>(),
      shape<void>(),
      shape<void, O>(),
      shape<void, O, O>(),
      shape<void, O, O, O>(),
      shape<void, O, O, O, bool>(),
      shape<void, bool>(),
      shape<void, std::uint64_t>(),
      shape<void, const LabelBlock&>(),
      shape<void, const FlagBlock&>(),
      shape<bool>(),
      shape<bool, O>(),
      shape<Q>(),
      shape<std::uint64_t>(),
      shape<float, O>(),
      shape<double>(),
      shape<double, O>(),
      shape<CGRect>(),
      shape<CGPoint>(),
  };
  const auto* const found = std::ranges::find(shapes, signature, &Shape::signature);
  return found == std::end(shapes) ? nullptr : found;
}

}  // namespace tavro::drift
