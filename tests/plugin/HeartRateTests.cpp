#include <limits>

#include "host/screens/workouts/HeartRateChart.h"
#include "host/screens/workouts/NoHeartRateData.h"
#include "platform/foundation/NSValue.h"
#include "platform/healthkit/HKWorkout.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Utterances = std::vector<std::string>;
using Readings = std::vector<HeartRateReading>;

/// A chart view whose host answers what a test wants it to answer.
class OddHeartRateChart : public CHWorkoutDetailHeartRateChartView {
 public:
  static constexpr Name className = "OddHeartRateChart";
  id interval;
  bool raises = false;
  std::uint64_t slices = 8;

  id oddInterval() {
    if (raises) {
      raise("OddException", "no interval");
    }
    return interval;
  }
  std::uint64_t oddSlices() { return slices; }
};
const Registered oddChart =
    defineClass<OddHeartRateChart, CHWorkoutDetailHeartRateChartView>()
        .method<&OddHeartRateChart::oddInterval>("_dateInterval")
        .method<&OddHeartRateChart::oddSlices>("_accessibilityNumberOfSlices");

/// Counts how often it is asked when it was.
class CountedReading : public HKHeartRateSummaryReading {
 public:
  static constexpr Name className = "CountedReading";
  static inline int asked = 0;
  id countedDate() {
    ++asked;
    return moment;
  }
};
const Registered countedReading =
    defineClass<CountedReading, HKHeartRateSummaryReading>().method<&CountedReading::countedDate>(
        "date");

class RaisingReading : public HKHeartRateSummaryReading {
 public:
  static constexpr Name className = "RaisingReading";
  id raisingDate() { raise("OddException", "no date"); }
};
const Registered raisingReading =
    defineClass<RaisingReading, HKHeartRateSummaryReading>().method<&RaisingReading::raisingDate>(
        "date");

/// A data source that has never heard of slices.
class PlainDataSource : public NSObject {
 public:
  static constexpr Name className = "PlainDataSource";
};
const Registered plainDataSource =
    defineClass<PlainDataSource, NSObject>().protocol(kTVUIChartDataSource);

/// A screen some of whose parts are not what the plug-in expects.
class OddNoDataScreen : public CHNoHeartRateDataViewController {
 public:
  static constexpr Name className = "OddNoDataScreen";
  id raisingTitle() { raise("OddException", "no title"); }
};
const Registered oddNoDataScreen = defineClass<OddNoDataScreen, CHNoHeartRateDataViewController>()
                                       .method<&OddNoDataScreen::raisingTitle>("titleLabel");

constexpr double kFortyMinutes = 2400;

Workout workoutOf(double duration, Readings readings) {
  Workout workout;
  workout.start.iso = "2026-03-11T07:00";
  workout.duration = duration;
  workout.heartRate = std::move(readings);
  return workout;
}

Ref<NSDate> momentAt(double offset) {
  return dateWithSeconds(secondsFromIso("2026-03-11T07:00").value() + offset);
}

template <class T = HKHeartRateSummaryReading>
Ref<T> readingOf(double offset, const Ref<HKQuantity>& quantity) {
  auto reading = make<T>();
  reading->moment = momentAt(offset);
  reading->heartRate = quantity;
  return reading;
}

Ref<HKQuantity> beats(double perMinute) {
  return HKQuantity::quantityWithUnit(HKUnit::countUnit()->unitDividedByUnit(HKUnit::minuteUnit()),
                                      perMinute);
}

class HeartRateTest : public PluginTest {
 protected:
  Ref<CHWorkoutDetailHeartRateChartTableViewCell> rowOf(double duration, Readings readings) {
    auto row = as<CHWorkoutDetailHeartRateChartTableViewCell>(
        heartRateRow(workoutOf(duration, std::move(readings))));
    row->setFrame({0, 0, 390, CHWorkoutDetailHeartRateChartTableViewCell::height});
    show(row);
    return row;
  }

  static Ref<OddHeartRateChart> oddChartOf(const id& interval) {
    auto chart = makeView<OddHeartRateChart>();
    chart->interval = interval;
    return chart;
  }

  static std::string quantity(const id& chart, std::uint64_t slice) {
    return utf8(send<id>(chart, "_accessibilityQuantityForSliceAtIndex:", slice));
  }
};

TEST_F(HeartRateTest, TheSliceInterfaceHasExactlyTheseTypes) {
  const struct {
    Name selector;
    std::string_view encodings;
  } methods[] = {
      {"_accessibilityShouldUseSlices", "B"},
      {"_accessibilityNumberOfSlices", "Q"},
      {"_accessibilityQuantityForSliceAtIndex:", "@,Q"},
      {"_accessibilityTimeIntervalPerSlice", "d"},
      {"_accessibilityHoursPerSlice", "Q"},
      {"_decimalForDate:", "f,@"},
      {"_axDateInterval", "@"},
  };
  for (const auto& [selector, encodings] : methods) {
    const Method* const method = classOf<CHWorkoutDetailHeartRateChartView>()->method(selector);
    ASSERT_NE(method, nullptr) << selector.text();
    EXPECT_EQ(method->signature.encodings, encodings) << selector.text();
  }
}

TEST_F(HeartRateTest, ASliceSaysItsRateOrItsRange) {
  const double infinity = std::numeric_limits<double>::infinity();
  const struct {
    Readings readings;
    const char* first;
  } cases[] = {
      {{{10, 120}, {20, 121.4}, {30, 119.6}}, "120 to 121 beats per minute"},
      {{{10, 87.5}, {20, 88.4}}, "88 beats per minute"},
      {{{10, 70.5}}, "71 beats per minute"},
      {{{10, 150}, {20, 90}, {30, 120}}, "90 to 150 beats per minute"},
      {{{400, 120}}, ""},
      {{}, ""},
      // What rounds to no beat is no heart rate, unless there is one beside it.
      {{{10, 0}}, ""},
      {{{10, 0.4}, {20, -5}}, ""},
      {{{10, 0}, {20, 90}}, "0 to 90 beats per minute"},
      {{{10, infinity}, {20, 90}, {30, std::nan("")}}, "90 beats per minute"},
  };
  for (const auto& [readings, first] : cases) {
    const auto row = rowOf(kFortyMinutes, readings);
    EXPECT_EQ(quantity(id(&row->chart()), 0), first) << testing::PrintToString(readings.size());
  }
}

TEST_F(HeartRateTest, AReadingBetweenTwoSlicesCountsInBoth) {
  const auto row = rowOf(kFortyMinutes, {{900, 95}, {2400, 130}});
  const id chart(&row->chart());
  const char* const expected[] = {"", "", "95 beats per minute", "95 beats per minute", "",
                                  "", "", "130 beats per minute"};
  for (std::uint64_t slice = 0; slice < 8; ++slice) {
    EXPECT_EQ(quantity(chart, slice), expected[slice]) << slice;
  }
  EXPECT_EQ(quantity(chart, 9), "") << "beyond the chart";
  EXPECT_EQ(quantity(chart, std::numeric_limits<std::uint64_t>::max()), "");
}

TEST_F(HeartRateTest, WhatIsNoReadingIsLeftOutAndTheRestSpeaks) {
  const auto chart = oddChartOf(dateInterval(momentAt(0), momentAt(kFortyMinutes)));
  const auto undated = readingOf(10, beats(60));
  undated->moment = nullptr;
  chart->_heartRateReadings = arrayWithObjects(
      {string("55"), number(55.0), undated, readingOf<RaisingReading>(10, beats(61)),
       readingOf(10, nullptr), readingOf(10, HKQuantity::quantityWithUnit(HKUnit::meterUnit(), 62)),
       readingOf(10, beats(90))});
  EXPECT_EQ(quantity(chart, 0), "90 beats per minute");
  chart->_heartRateReadings = nullptr;
  EXPECT_EQ(quantity(chart, 0), "");
}

TEST_F(HeartRateTest, TheIntervalDecidesHowLongASliceIs) {
  const struct {
    double hours;
    std::uint64_t slices;
    double seconds;
    std::uint64_t wholeHours;
  } cases[] = {
      {2.0 / 3, 8, 300, 0},
      {7.99, 8, 3595.5, 0},
      {8, 8, 3600, 1},
      {15.99, 8, 7195.5, 1},
      {16, 8, 7200, 2},
      {0, 8, 0, 0},
      // The number of slices is the chart's to say.
      {8, 4, 7200, 2},
  };
  for (const auto& each : cases) {
    const auto chart = oddChartOf(dateInterval(momentAt(0), momentAt(each.hours * 3600)));
    chart->slices = each.slices;
    EXPECT_DOUBLE_EQ(send<double>(chart, "_accessibilityTimeIntervalPerSlice"), each.seconds);
    EXPECT_EQ(send<std::uint64_t>(chart, "_accessibilityHoursPerSlice"), each.wholeHours)
        << each.hours;
    chart->_heartRateReadings = arrayWithObjects({readingOf(each.seconds * 1.5, beats(80))});
    EXPECT_EQ(quantity(chart, 1), "80 beats per minute") << each.hours;
  }
}

TEST_F(HeartRateTest, WithoutAnIntervalThereIsNoTimeAndNoQuantity) {
  const auto backwards = make<NSDateInterval>();
  backwards->startDate = momentAt(100);
  backwards->endDate = momentAt(0);
  const struct {
    const char* name;
    id interval;
    bool raises;
    double seconds;
  } cases[] = {
      {"absent", nullptr, false, 0},
      {"of another class", string("an hour"), false, 0},
      {"raising", nullptr, true, 0},
      {"without dates", make<NSDateInterval>(), false, 0},
      {"ending before its start", backwards, false, -12.5},
  };
  for (const auto& each : cases) {
    SCOPED_TRACE(each.name);
    const auto chart = oddChartOf(each.interval);
    chart->raises = each.raises;
    chart->_heartRateReadings = arrayWithObjects({readingOf(0, beats(80))});
    EXPECT_EQ(send<double>(chart, "_accessibilityTimeIntervalPerSlice"), each.seconds);
    EXPECT_EQ(send<std::uint64_t>(chart, "_accessibilityHoursPerSlice"), 0U);
    EXPECT_EQ(quantity(chart, 0), "");
  }
}

TEST_F(HeartRateTest, ATimeOfDayIsADecimalHourInTheUsersTimeZone) {
  const struct {
    const char* timeZone;
    const char* utc;
    float hours;
  } cases[] = {
      {"UTC", "2026-03-11T09:15:00Z", 9.25F},
      {"UTC", "2026-03-11T14:30:36Z", 14.51F},
      {"UTC", "2026-03-11T00:00:00Z", 0},
      {"Asia/Kolkata", "2026-03-11T09:15:00Z", 14.75F},
  };
  const auto chart = makeView<CHWorkoutDetailHeartRateChartView>();
  for (const auto& [timeZone, utc, hours] : cases) {
    Settings::current().timeZone = timeZone;
    const auto date = dateWithSeconds(secondsFromIso(utc).value());
    EXPECT_EQ(send<float>(chart, "_decimalForDate:", date), hours) << utc;
  }
  EXPECT_EQ(send<float>(chart, "_decimalForDate:", nullptr), 0);
  EXPECT_EQ(send<float>(chart, "_decimalForDate:", string("noon")), 0);
}

TEST_F(HeartRateTest, ALongWorkoutIsGoneThroughOncePerSlice) {
  constexpr int kReadings = 200'000;
  const auto chart = oddChartOf(dateInterval(momentAt(0), momentAt(kReadings)));
  const Ref<NSMutableArray> readings = mutableArray(kReadings);
  const Ref<HKQuantity> rates[] = {beats(60), beats(180), beats(120)};
  for (int second = 0; second < kReadings; ++second) {
    readings->addObject(readingOf<CountedReading>(second, rates[second % 3]));
  }
  chart->_heartRateReadings = readings;
  EXPECT_EQ(quantity(chart, 3), "60 to 180 beats per minute");
  EXPECT_EQ(CountedReading::asked, kReadings);
}

TEST_F(HeartRateTest, TheChartReadsOneElementASlice) {
  const auto row = rowOf(kFortyMinutes, {{0, 80}, {350, 120}, {399, 131}, {2399, 140}});
  EXPECT_EQ(heard(row), (Utterances{
                            "Heart Rate",
                            "7:00\u2009–\u20097:05\u202fAM, 80 beats per minute",
                            "7:05\u2009–\u20097:10\u202fAM, 120 to 131 beats per minute",
                            "7:10\u2009–\u20097:15\u202fAM",
                            "7:15\u2009–\u20097:20\u202fAM",
                            "7:20\u2009–\u20097:25\u202fAM",
                            "7:25\u2009–\u20097:30\u202fAM",
                            "7:30\u2009–\u20097:35\u202fAM",
                            "7:35\u2009–\u20097:40\u202fAM, 140 beats per minute",
                        }));
  const id container = row->chart()._chartView->_containerView;
  const Ref<NSArray> handedOut = elementsOf(id(&row->chart()));
  ASSERT_EQ(handedOut->count(), 1U);
  EXPECT_EQ((*handedOut)[0], container);
  const Ref<NSArray> slices = elementsOf(container);
  const auto whole = send<CGRect>(container, "accessibilityFrame");
  const auto last = send<CGRect>((*slices)[7], "accessibilityFrame");
  EXPECT_DOUBLE_EQ(last.size.width, whole.size.width / 8);
  EXPECT_DOUBLE_EQ(last.maxX(), whole.maxX());
  EXPECT_EQ((*elementsOf(container))[7], (*slices)[7]) << "a finger finds the same element again";
}

TEST_F(HeartRateTest, SlicesOfSecondsSayTheirSeconds) {
  const auto row = rowOf(240, {{10, 80}, {20, 90}});
  EXPECT_EQ(heard(row)[2], "7:00:30\u202fAM\u2009–\u20097:01:00\u202fAM");
}

TEST_F(HeartRateTest, AChartWithoutASourceOfSlicesIsSilent) {
  const auto row = rowOf(kFortyMinutes, {{0, 80}, {350, 120}});
  const Ref<TVUIChartView> chart = row->chart()._chartView;
  const Ref<NSArray> slices = elementsOf(chart->_containerView);
  const auto plain = make<PlainDataSource>();
  chart->setDataSource(plain);
  EXPECT_EQ(elementsOf(chart->_containerView)->count(), 0U);
  EXPECT_EQ(valueOf((*slices)[0]), "") << "kept by somebody from before";
  chart->_containerView = nullptr;
  EXPECT_EQ(elementsOf(id(&row->chart()))->count(), 0U);
  row->chart()._chartView = nullptr;
  EXPECT_EQ(elementsOf(id(&row->chart()))->count(), 0U);
}

TEST_F(HeartRateTest, TooLittleDataMakesTheOverlayOneButton) {
  const auto row = rowOf(kFortyMinutes, {{0, 80}});
  EXPECT_EQ(heard(row), (Utterances{"Heart Rate", "No heart rate was recorded, button"}));
  EXPECT_FALSE(send<bool>(id(&row->chart()), "_accessibilityShouldUseSlices"));
  row->setWorkout(workoutOf(kFortyMinutes, {{0, 80}, {1, 80}}));
  EXPECT_FALSE(send<bool>(row->_noDataOverlayView, "isAccessibilityElement"));
  EXPECT_EQ(heard(row).size(), 9U) << "the title and the slices";
  row->setWorkout(workoutOf(kFortyMinutes, {}));
  EXPECT_EQ(heard(row), (Utterances{"Heart Rate", "No heart rate was recorded, button"}));

  EXPECT_TRUE(send<bool>(row->_noDataOverlayView, "accessibilityActivate"));
  EXPECT_TRUE(
      isKindOf(window->rootViewController().get(), classOf<CHNoHeartRateDataViewController>()));
}

TEST_F(HeartRateTest, TheOverlayIsAnnotatedAsSoonAsTheHostMadeIt) {
  const auto row = makeView<CHWorkoutDetailHeartRateChartTableViewCell>();
  send<void>(row, "_createAndConstraintNoDataOverlay");
  EXPECT_TRUE(send<bool>(row->_noDataOverlayView, "isAccessibilityElement")) << "not yet on screen";
  EXPECT_EQ(labelOf(row->_noDataOverlayView), "No heart rate was recorded");
}

TEST_F(HeartRateTest, AnOverlaySaysItsFirstLabelElseAllThatIsInIt) {
  const auto inner = makeView<UIView>({0, 0, 200, 20});
  inner->addSubview(makeLabel("inside", {0, 0, 100, 20}));
  const auto button = makeView<UIButton>({0, 40, 100, 20});
  button->setTitle(string("press"));
  const auto overlay = makeView<UIView>({0, 0, 390, 100});
  overlay->addSubview(inner);
  const auto row = makeView<CHWorkoutDetailHeartRateChartTableViewCell>();
  row->_noDataOverlayView = overlay;
  send<void>(overlay, "setAccessibilityTraits:", UIAccessibilityTraitSelected);
  send<void>(row, "_accessibilityLoadAccessibilityInformation");

  EXPECT_EQ(send<UIAccessibilityTraits>(overlay, "accessibilityTraits"),
            UIAccessibilityTraitButton);
  EXPECT_EQ(labelOf(overlay), "inside");
  EXPECT_FALSE(send<bool>(overlay, "accessibilityActivate")) << "there is no button";
  overlay->addSubview(button);
  EXPECT_EQ(labelOf(overlay), "inside, press");
  EXPECT_FALSE(send<bool>(overlay, "accessibilityActivate")) << "the button does nothing";
  int presses = 0;
  button->setAction([&presses] { ++presses; });
  EXPECT_TRUE(send<bool>(overlay, "accessibilityActivate"));
  EXPECT_EQ(presses, 1);
  overlay->addSubview(makeLabel("first direct label", {0, 60, 100, 20}));
  overlay->addSubview(makeLabel("second direct label", {0, 0, 100, 20}));
  EXPECT_EQ(labelOf(overlay), "first direct label");
}

TEST_F(HeartRateTest, TheBlocksKeepNothingAliveAndAreEmptyOnceItIsGone) {
  auto row = makeView<CHWorkoutDetailHeartRateChartTableViewCell>();
  send<void>(row, "_createAndConstraintNoDataOverlay");
  const Weak<UIView> overlay(row->_noDataOverlayView);
  const auto& blocks = *accessibilityAttributes(*row->_noDataOverlayView).rare;
  const FlagBlock isElement = blocks.isElement;
  const LabelBlock label = blocks.label;
  const FlagBlock activate = blocks.activate;
  EXPECT_TRUE(isElement());
  row = nullptr;
  ASSERT_FALSE(overlay.strong());
  EXPECT_FALSE(isElement());
  EXPECT_FALSE(label());
  EXPECT_FALSE(activate());

  auto screen = makeController<CHNoHeartRateDataViewController>();
  const Ref<UIView> view = screen->view();
  const id linkButton = screen->linkButton();
  EXPECT_EQ(labelOf(linkButton), "How to measure your heart rate");
  const Weak<CHNoHeartRateDataViewController> held(screen);
  screen = nullptr;
  ASSERT_FALSE(held.strong());
  EXPECT_FALSE(send<id>(linkButton, "accessibilityLabel"));
}

TEST_F(HeartRateTest, TheNoDataScreenReadsItsLinkOnce) {
  const auto screen = makeController<CHNoHeartRateDataViewController>();
  window->setRootViewController(screen);
  const std::string text =
      "Your heart rate is recorded when you wear your watch snugly and start the workout on it.";
  EXPECT_EQ(heard(window), (Utterances{"No Heart Rate Data, heading", text,
                                       "How to measure your heart rate, button"}));
  as<UILabel>(screen->linkLabel())->setText(string("Another link"));
  send<void>(screen->titleLabel(), "setAccessibilityTraits:", UIAccessibilityTraitSelected);
  send<void>(screen, "_accessibilityLoadAccessibilityInformation");
  EXPECT_EQ(heard(window),
            (Utterances{"No Heart Rate Data, selected, heading", text, "Another link, button"}));
}

TEST_F(HeartRateTest, AScreenWithoutATitleStillHasItsLink) {
  const auto screen = makeController<OddNoDataScreen>();
  window->setRootViewController(screen);
  EXPECT_EQ(heard(window).front(), "No Heart Rate Data");
  EXPECT_EQ(heard(window).back(), "How to measure your heart rate, button");
}

}  // namespace
}  // namespace tavro
