#include <limits>
#include <tuple>

#include "host/screens/workouts/HeartRateChart.h"
#include "host/screens/workouts/NoHeartRateData.h"
#include "platform/foundation/NSValue.h"
#include "platform/healthkit/HKWorkout.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Readings = std::vector<HeartRateReading>;

using Row = CHWorkoutDetailHeartRateChartTableViewCell;
using ChartView = CHWorkoutDetailHeartRateChartView;

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

Ref<HKHeartRateSummaryReading> readingOf(double offset, const Ref<HKQuantity>& quantity) {
  auto reading = make<HKHeartRateSummaryReading>();
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
  Ref<Row> rowOf(double duration, Readings readings) {
    auto row = as<Row>(heartRateRow(workoutOf(duration, std::move(readings))));
    row->setFrame({0, 0, 390, Row::height});
    show(row);
    return row;
  }

  static Ref<ChartView> chartOf(const id& interval) {
    auto chart = makeView<ChartView>();
    answers(chart, "_dateInterval", interval);
    return chart;
  }

  static std::string quantity(const id& chart, std::uint64_t slice) {
    return utf8(send<id>(chart, "_accessibilityQuantityForSliceAtIndex:", slice));
  }
};

TEST_F(HeartRateTest, ASliceSaysItsRateOrItsRange) {
  const double infinity = std::numeric_limits<double>::infinity();
  const std::pair<Readings, const char*> cases[] = {
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
  const auto chart = chartOf(dateInterval(momentAt(0), momentAt(kFortyMinutes)));
  const auto undated = readingOf(10, beats(60));
  undated->moment = nullptr;
  const auto raising = readingOf(10, beats(61));
  raises(raising, "date");
  chart->_heartRateReadings =
      arrayWithObjects({string("55"), number(55.0), undated, raising, readingOf(10, nullptr),
                        readingOf(10, HKQuantity::quantityWithUnit(HKUnit::meterUnit(), 62)),
                        readingOf(10, beats(90))});
  EXPECT_EQ(quantity(chart, 0), "90 beats per minute");
  chart->_heartRateReadings = nullptr;
  EXPECT_EQ(quantity(chart, 0), "");
}

TEST_F(HeartRateTest, TheIntervalDecidesHowLongASliceIs) {
  const std::tuple<double, std::uint64_t, double, std::uint64_t> cases[] = {
      {2.0 / 3, 8, 300, 0},
      {7.99, 8, 3595.5, 0},
      {8, 8, 3600, 1},
      {15.99, 8, 7195.5, 1},
      {16, 8, 7200, 2},
      {0, 8, 0, 0},
      // The number of slices is the chart's to say.
      {8, 4, 7200, 2},
  };
  for (const auto& [hours, slices, seconds, wholeHours] : cases) {
    const auto chart = chartOf(dateInterval(momentAt(0), momentAt(hours * 3600)));
    answers<std::uint64_t>(chart, "_accessibilityNumberOfSlices",
                           [&, count = slices] { return count; });
    EXPECT_DOUBLE_EQ(send<double>(chart, "_accessibilityTimeIntervalPerSlice"), seconds);
    EXPECT_EQ(send<std::uint64_t>(chart, "_accessibilityHoursPerSlice"), wholeHours) << hours;
    chart->_heartRateReadings = arrayWithObjects({readingOf(seconds * 1.5, beats(80))});
    EXPECT_EQ(quantity(chart, 1), "80 beats per minute") << hours;
  }
}

TEST_F(HeartRateTest, WithoutAnIntervalThereIsNoTimeAndNoQuantity) {
  const auto backwards = make<NSDateInterval>();
  backwards->startDate = momentAt(100);
  backwards->endDate = momentAt(0);
  const auto raising = chartOf(nullptr);
  raises(raising, "_dateInterval");
  const std::tuple<const char*, Ref<ChartView>, double> cases[] = {
      {"absent", chartOf(nullptr), 0},
      {"of another class", chartOf(string("an hour")), 0},
      {"raising", raising, 0},
      {"without dates", chartOf(make<NSDateInterval>()), 0},
      {"ending before its start", chartOf(backwards), -12.5},
  };
  for (const auto& [name, chart, seconds] : cases) {
    SCOPED_TRACE(name);
    chart->_heartRateReadings = arrayWithObjects({readingOf(0, beats(80))});
    EXPECT_EQ(send<double>(chart, "_accessibilityTimeIntervalPerSlice"), seconds);
    EXPECT_EQ(send<std::uint64_t>(chart, "_accessibilityHoursPerSlice"), 0U);
    EXPECT_EQ(quantity(chart, 0), "");
  }
}

TEST_F(HeartRateTest, ATimeOfDayIsADecimalHourInTheUsersTimeZone) {
  const std::tuple<const char*, const char*, float> cases[] = {
      {"UTC", "2026-03-11T09:15:00Z", 9.25F},
      {"UTC", "2026-03-11T14:30:36Z", 14.51F},
      {"UTC", "2026-03-11T00:00:00Z", 0},
      {"Asia/Kolkata", "2026-03-11T09:15:00Z", 14.75F},
  };
  const auto chart = makeView<ChartView>();
  for (const auto& [timeZone, utc, hours] : cases) {
    Settings::current().timeZone = timeZone;
    const auto date = dateWithSeconds(secondsFromIso(utc).value());
    EXPECT_EQ(send<float>(chart, "_decimalForDate:", date), hours) << utc;
  }
  EXPECT_EQ(send<float>(chart, "_decimalForDate:", nullptr), 0);
  EXPECT_EQ(send<float>(chart, "_decimalForDate:", string("noon")), 0);
}

TEST_F(HeartRateTest, AReadingIsAskedOnceASliceWhenItWas) {
  const auto chart = chartOf(dateInterval(momentAt(0), momentAt(kFortyMinutes)));
  int asked = 0;
  std::vector<id> readings;
  for (int second = 0; second < kFortyMinutes; ++second) {
    readings.emplace_back(readingOf(second, beats(60 + 60 * (second % 3))));
    answers<id>(readings.back(), "date", [&asked, second] {
      ++asked;
      return momentAt(second);
    });
  }
  chart->_heartRateReadings = arrayWithObjects(std::move(readings));
  EXPECT_EQ(quantity(chart, 3), "60 to 180 beats per minute");
  EXPECT_EQ(asked, kFortyMinutes);
}

TEST_F(HeartRateTest, TheChartReadsOneElementASlice) {
  const auto row = rowOf(kFortyMinutes, {{0, 80}, {350, 120}, {399, 131}, {2399, 140}});
  const Utterances spoken = heard(row);
  ASSERT_EQ(spoken.size(), 9U);
  EXPECT_EQ(spoken[3], "7:10\u2009–\u20097:15\u202fAM") << "no reading, its time alone";
  EXPECT_EQ(spoken[8], "7:35\u2009–\u20097:40\u202fAM, 140 beats per minute");
  const id container = row->chart()._chartView->_containerView;
  const Ref<NSArray> handedOut = elementsOf(id(&row->chart()));
  ASSERT_EQ(handedOut->count(), 1U);
  EXPECT_EQ((*handedOut)[0], container);
  const Ref<NSArray> slices = elementsOf(container);
  const auto whole = frameOf(container);
  const auto last = frameOf((*slices)[7]);
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
  const auto plain = make<NSObject>();
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
  EXPECT_FALSE(isElement(row->_noDataOverlayView));
  EXPECT_EQ(heard(row).size(), 9U) << "the title and the slices";
  row->setWorkout(workoutOf(kFortyMinutes, {}));
  EXPECT_EQ(heard(row), (Utterances{"Heart Rate", "No heart rate was recorded, button"}));

  EXPECT_TRUE(activate(row->_noDataOverlayView));
  EXPECT_TRUE(
      isKindOf(window->rootViewController().get(), classOf<CHNoHeartRateDataViewController>()));
}

TEST_F(HeartRateTest, TheOverlayIsAnnotatedAsSoonAsTheHostMadeIt) {
  const auto row = makeView<Row>();
  send<void>(row, "_createAndConstraintNoDataOverlay");
  EXPECT_TRUE(isElement(row->_noDataOverlayView)) << "not yet on screen";
  EXPECT_EQ(labelOf(row->_noDataOverlayView), "No heart rate was recorded");
}

TEST_F(HeartRateTest, AnOverlaySaysItsFirstLabelElseAllThatIsInIt) {
  const auto inner = makeView<UIView>({0, 0, 200, 20});
  inner->addSubview(makeLabel("inside", {0, 0, 100, 20}));
  const auto button = makeView<UIButton>({0, 40, 100, 20});
  button->setTitle(string("press"));
  const auto overlay = makeView<UIView>({0, 0, 390, 100});
  overlay->addSubview(inner);
  const auto row = makeView<Row>();
  row->_noDataOverlayView = overlay;
  setTraits(overlay, UIAccessibilityTraitSelected);
  load(row);

  EXPECT_EQ(traitsOf(overlay), UIAccessibilityTraitButton);
  EXPECT_EQ(labelOf(overlay), "inside");
  EXPECT_FALSE(activate(overlay)) << "there is no button";
  overlay->addSubview(button);
  EXPECT_EQ(labelOf(overlay), "inside, press");
  EXPECT_FALSE(activate(overlay)) << "the button does nothing";
  int presses = 0;
  button->setAction([&presses] { ++presses; });
  EXPECT_TRUE(activate(overlay));
  EXPECT_EQ(presses, 1);
  overlay->addSubview(makeLabel("first direct label", {0, 60, 100, 20}));
  overlay->addSubview(makeLabel("second direct label", {0, 0, 100, 20}));
  EXPECT_EQ(labelOf(overlay), "first direct label");
}

TEST_F(HeartRateTest, TheBlocksKeepNothingAliveAndAreEmptyOnceItIsGone) {
  auto row = makeView<Row>();
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
  as<UILabel>(screen->linkLabel())->setText(string("Another link"));
  setTraits(screen->titleLabel(), UIAccessibilityTraitSelected);
  load(screen);
  const Utterances spoken = heard(window);
  ASSERT_EQ(spoken.size(), 3U);
  EXPECT_EQ(spoken.front(), "No Heart Rate Data, selected, heading");
  EXPECT_EQ(spoken.back(), "Another link, button");
}

TEST_F(HeartRateTest, AScreenWithoutATitleStillHasItsLink) {
  const auto screen = makeController<CHNoHeartRateDataViewController>();
  raises(screen, "titleLabel");
  const Utterances spoken = heardOn(screen);
  EXPECT_EQ(spoken.front(), "No Heart Rate Data");
  EXPECT_EQ(spoken.back(), "How to measure your heart rate, button");
}

}  // namespace
}  // namespace tavro
