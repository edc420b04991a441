#include <benchmark/benchmark.h>

#include "bench/Bench.h"
#include "platform/accessibility/KeyAccess.h"

namespace tavro::bench {
namespace {

class Row : public NSObject {
 public:
  static constexpr Name className = "BenchRow";
  Ref<NSString> _title;
  Ref<NSString> subtitle_;
  id subtitle() { return subtitle_; }
};

const Registered row = defineClass<Row, NSObject>()
                           .method<&Row::subtitle>("subtitle")
                           .variable<&Row::_title>("_title");

Ref<Row> makeRow() {
  auto made = make<Row>();
  made->_title = string("title");
  made->subtitle_ = string("subtitle");
  return made;
}

template <class Read>
void reading(benchmark::State& state, const Read& read) {
  const Ref<Row> row = makeRow();
  Object* object = row.get();
  for (auto _ : state) {
    benchmark::DoNotOptimize(object);
    benchmark::DoNotOptimize(read(object));
  }
}

void readVariable(benchmark::State& state) {
  reading(state, [](Object* object) { return typedRead<NSString>(object, "_title"); });
}
void readAccessor(benchmark::State& state) {
  reading(state, [](Object* object) { return typedRead<NSString>(object, "subtitle"); });
}
void readAbsent(benchmark::State& state) {
  reading(state, [](Object* object) { return typedRead<NSString>(object, "nothingOfThatName"); });
}
void readWeak(benchmark::State& state) {
  const Ref<Row> row = makeRow();
  const Weak<Row> weak(row);
  for (auto _ : state) {
    benchmark::DoNotOptimize(weak);
    benchmark::DoNotOptimize(weak.strong());
  }
}

void readRetained(benchmark::State& state) {
  const Ref<Row> row = makeRow();
  _accessibilitySetRetainedValue(row.get(), string("points"), "kAXPoints");
  _accessibilitySetRetainedValue(row.get(), string("kept"), kUIAccessibilityStorageKeyChildren);
  Object* object = row.get();
  for (auto _ : state) {
    benchmark::DoNotOptimize(object);
    benchmark::DoNotOptimize(_accessibilityValueForKey(object, kUIAccessibilityStorageKeyChildren));
  }
}

void writeRetained(benchmark::State& state) {
  const Ref<Row> row = makeRow();
  const id values[] = {string("one"), string("other")};
  std::size_t turn = 0;
  for (auto _ : state) {
    _accessibilitySetRetainedValue(row.get(), values[++turn & 1U],
                                   kUIAccessibilityStorageKeyChildren);
  }
}

}  // namespace

void registerStorageBenchmarks() {
  benchmark::RegisterBenchmark("key:variable", &readVariable);
  benchmark::RegisterBenchmark("key:accessor", &readAccessor);
  benchmark::RegisterBenchmark("key:absent", &readAbsent);
  benchmark::RegisterBenchmark("weak:read", &readWeak);
  benchmark::RegisterBenchmark("retained:read", &readRetained);
  benchmark::RegisterBenchmark("retained:write", &writeRetained);
}

}  // namespace tavro::bench
