#include <benchmark/benchmark.h>

#include <functional>

#include "bench/Ratios.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/NSString.h"

namespace tavro::bench {
namespace {

/// What a send is measured against: the same work behind a virtual function.
class Shape {
 public:
  virtual ~Shape() = default;
  virtual std::int64_t area(std::int64_t scale) = 0;
};
class Square : public Shape {
 public:
  __attribute__((noinline)) std::int64_t area(std::int64_t scale) override { return scale + 1; }
};

class Plain : public NSObject {
 public:
  static constexpr Name className = "BenchPlain";
  __attribute__((noinline)) std::int64_t area(std::int64_t scale) { return scale + 1; }
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

const Registered plain = defineClass<Plain, NSObject>().method<&Plain::area>("area:");
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

void functionCall(benchmark::State& state) {
  std::function<std::int64_t(std::int64_t)> area = [](std::int64_t scale) { return scale + 1; };
  for (auto _ : state) {
    benchmark::DoNotOptimize(area);
    benchmark::DoNotOptimize(area(3));
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

}  // namespace

void registerMessageBenchmarks() {
  installSafeCategory("BenchWrappedAccessibility");
  benchmark::RegisterBenchmark("virtual", &virtualCall);
  benchmark::RegisterBenchmark("function", &functionCall);
  benchmark::RegisterBenchmark("send", &sendTo<Plain>);
  benchmark::RegisterBenchmark("send+super", &sendTo<Wrapped>);
  benchmark::RegisterBenchmark("trySend", &trySendTo);
}

}  // namespace tavro::bench
