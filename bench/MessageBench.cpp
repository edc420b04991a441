#include <benchmark/benchmark.h>

#include <array>
#include <memory>
#include <stdexcept>

#include "bench/Bench.h"
#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/NSString.h"

namespace tavro::bench {
namespace {

constexpr int kClasses = 8;
constexpr std::size_t kTurns = 512;
constexpr std::int64_t kFrames = 10;

/// What messages are measured against: the same work behind virtual functions.
class Shape {
 public:
  virtual ~Shape() = default;
  virtual std::int64_t area(std::int64_t scale) = 0;
  virtual std::int64_t descend(std::int64_t /*frames*/) { return 0; }
};
template <int N>
class Sided : public Shape {
 public:
  __attribute__((noinline)) std::int64_t area(std::int64_t scale) override { return scale + N; }
  // Not a call in last place, which would leave no frame.
  __attribute__((noinline)) std::int64_t descend(std::int64_t frames) override {
    if (frames == 0) {
      throw std::out_of_range("there is nothing further down");
    }
    Shape* next = this;
    benchmark::DoNotOptimize(next);
    return next->descend(frames - 1) + 1;
  }
};
using Square = Sided<4>;

/// The same eight classes as receivers of messages.
constexpr std::array<Name, kClasses> kNames = {"BenchShape0", "BenchShape1", "BenchShape2",
                                               "BenchShape3", "BenchShape4", "BenchShape5",
                                               "BenchShape6", "BenchShape7"};
template <int N>
class Drawn : public NSObject {
 public:
  static constexpr Name className = kNames[N];
  __attribute__((noinline)) std::int64_t area(std::int64_t scale) { return scale + N; }
};
template <std::size_t... N>
std::array<Registered, kClasses> registerDrawn(std::index_sequence<N...> /*indices*/) {
  return {
      Registered(defineClass<Drawn<N>, NSObject>().template method<&Drawn<N>::area>("area:"))...};
}
const std::array<Registered, kClasses> drawn = registerDrawn(std::make_index_sequence<kClasses>());

/// The classes in an order without a pattern, the same for both kinds of call.
template <class Pointer>
std::array<Pointer, kTurns> mixed(const std::array<Pointer, kClasses>& receivers) {
  std::array<Pointer, kTurns> mix{};
  std::uint32_t state = 1;
  for (Pointer& each : mix) {
    state = state * 1664525U + 1013904223U;
    each = receivers.at(state >> 29U);
  }
  return mix;
}

class Plain : public NSObject {
 public:
  static constexpr Name className = "BenchPlain";
  __attribute__((noinline)) std::int64_t area(std::int64_t scale) { return scale + 1; }
  __attribute__((noinline)) std::int64_t descend(std::int64_t frames) {
    if (frames == 0) {
      return send<std::int64_t>(this, "selectorThatNobodyHas");
    }
    return send<std::int64_t>(this, "descend:", frames - 1) + 1;
  }
};
class Wrapped : public Plain {
 public:
  static constexpr Name className = "BenchWrapped";
};

class WrappedAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "BenchWrappedAccessibility";
  static constexpr Name target = "BenchWrapped";
  std::int64_t area(std::int64_t scale) { return super.send<std::int64_t>(scale) + 1; }
};

const Registered plain =
    defineClass<Plain, NSObject>().method<&Plain::area>("area:").method<&Plain::descend>(
        "descend:");
const Registered wrapped = defineClass<Wrapped, Plain>().method<&Plain::area>("area:");
const Registered category =
    safeCategory<WrappedAccessibility, kNoHostContract>().method<&WrappedAccessibility::area>(
        "area:");

void virtualCall(benchmark::State& state) {
  Square square;
  Shape* shape = &square;
  for (auto _ : state) {
    benchmark::DoNotOptimize(shape);
    benchmark::DoNotOptimize(shape->area(3));
  }
}

template <std::size_t... N>
std::array<Shape*, kClasses> allSided(std::index_sequence<N...> /*indices*/) {
  static const std::array<std::unique_ptr<Shape>, kClasses> shapes{
      std::make_unique<Sided<static_cast<int>(N)>>()...};
  return {shapes[N].get()...};
}
template <std::size_t... N>
std::array<Object*, kClasses> allDrawn(std::index_sequence<N...> /*indices*/) {
  static const std::array<id, kClasses> shapes{id(make<Drawn<static_cast<int>(N)>>())...};
  return {shapes[N].get()...};
}

void virtualMix(benchmark::State& state) {
  const auto mix = mixed(allSided(std::make_index_sequence<kClasses>()));
  std::size_t turn = 0;
  for (auto _ : state) {
    benchmark::DoNotOptimize(mix[++turn % kTurns]->area(3));
  }
}

void sendMix(benchmark::State& state) {
  const auto mix = mixed(allDrawn(std::make_index_sequence<kClasses>()));
  std::size_t turn = 0;
  for (auto _ : state) {
    benchmark::DoNotOptimize(send<std::int64_t>(mix[++turn % kTurns], "area:", 3));
  }
}

void throwAndCatch(benchmark::State& state) {
  Square square;
  Shape* const shape = &square;
  for (auto _ : state) {
    try {
      benchmark::DoNotOptimize(shape->descend(kFrames));
    } catch (...) {
      benchmark::ClobberMemory();
    }
  }
}

void raiseAndContain(benchmark::State& state) {
  const Ref<Plain> object = make<Plain>();
  for (auto _ : state) {
    AXPerformSafeBlock(
        [&] { benchmark::DoNotOptimize(send<std::int64_t>(object, "descend:", kFrames)); });
  }
}

template <class T>
void sendTo(benchmark::State& state) {
  const Ref<T> object = make<T>();
  Object* receiver = object.get();
  for (auto _ : state) {
    benchmark::DoNotOptimize(receiver);
    benchmark::DoNotOptimize(send<std::int64_t>(receiver, "area:", 3));
  }
}

void trySendTo(benchmark::State& state) {
  const Ref<Plain> object = make<Plain>();
  Object* receiver = object.get();
  for (auto _ : state) {
    benchmark::DoNotOptimize(receiver);
    benchmark::DoNotOptimize(trySend<std::int64_t>(receiver, "area:", 3));
  }
}

/// A thousand messages, some of them through a category to what it replaced.
std::function<void()> sendMany() {
  const auto mix = mixed(allDrawn(std::make_index_sequence<kClasses>()));
  return [mix, wrapped = id(make<Wrapped>())] {
    std::int64_t sum = 0;
    for (Object* const each : mix) {
      sum += send<std::int64_t>(each, "area:", 3) + send<std::int64_t>(wrapped, "area:", 3);
    }
    require(sum > 0, "messages must be answered");
  };
}

}  // namespace

void addMessageWork(std::vector<Work>& all) {
  all.push_back({"messages", &sendMany, 2 * kTurns, false});
}

void registerMessageBenchmarks() {
  installSafeCategory("BenchWrappedAccessibility");
  benchmark::RegisterBenchmark("virtual", &virtualCall);
  benchmark::RegisterBenchmark("virtual mix", &virtualMix);
  benchmark::RegisterBenchmark("send mix", &sendMix);
  benchmark::RegisterBenchmark("throw", &throwAndCatch);
  benchmark::RegisterBenchmark("raise", &raiseAndContain);
  benchmark::RegisterBenchmark("send", &sendTo<Plain>);
  benchmark::RegisterBenchmark("send+super", &sendTo<Wrapped>);
  benchmark::RegisterBenchmark("trySend", &trySendTo);
}

}  // namespace tavro::bench
