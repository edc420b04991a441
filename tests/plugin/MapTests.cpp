#include "host/screens/workouts/MapAndWeather.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

Workout outdoors() {
  Workout workout;
  workout.route = Route{"Route", {{0, 0}, {300, 40}, {20, 180}}};
  workout.weather = Weather{"Clear", "9 °C", "50 %"};
  return workout;
}

class MapTest : public PluginTest {
 protected:
  Ref<CHWorkoutDetailMapAndWeatherTableViewCell> rowOf(const Workout& workout) {
    auto row = as<CHWorkoutDetailMapAndWeatherTableViewCell>(mapAndWeatherRow(workout));
    row->setFrame({0, 0, 390, CHWorkoutDetailMapAndWeatherTableViewCell::height});
    show(row);
    return row;
  }

  /// A view of that class with these views in it and nothing else.
  template <class T>
  Ref<T> viewWith(const std::vector<Ref<UIView>>& parts, CGRect frame) {
    auto view = makeView<T>(frame);
    const std::vector<Ref<UIView>> own = view->subviewList();
    for (const Ref<UIView>& each : own) {
      each->removeFromSuperview();
    }
    for (const Ref<UIView>& part : parts) {
      view->addSubview(part);
    }
    show(view);
    return view;
  }
};

TEST_F(MapTest, TheRowReadsThePartsThatItHas) {
  Workout part = outdoors();
  part.weather.reset();
  EXPECT_EQ(heard(rowOf(part)), Utterances{"Route, button, Shows the route on a larger map"});
  part = outdoors();
  part.route.reset();
  EXPECT_EQ(heard(rowOf(part)),
            (Utterances{"Clear, 9 °C, Humidity 50 %", "Weather Source, button"}));

  const auto bare = makeView<CHWorkoutDetailMapAndWeatherTableViewCell>();
  ASSERT_TRUE(elementsOf(bare));
  EXPECT_EQ(elementsOf(bare)->count(), 0U);
}

TEST_F(MapTest, TheOrderIsTheMapFirstWhereverItStands) {
  const auto row = rowOf(outdoors());
  row->_mapView->setFrame({0, 200, 390, 100});
  row->_weatherView->setFrame({0, 0, 390, 56});
  const Ref<NSArray> elements = elementsOf(row);
  EXPECT_EQ((*elements)[0], row->_mapView);
  EXPECT_EQ((*elements)[1], row->_weatherView);
}

TEST_F(MapTest, TheMapCoversWhatItShowsAndNotItself) {
  const auto map = viewWith<CHWorkoutDetailMapView>(
      {makeView<UIView>({10, 20, 100, 50}), makeView<UIView>({200, 100, 110, 120})},
      {0, 0, 390, 300});
  EXPECT_EQ(frameOf(map), CGRect(10, 20, 300, 200));
  map->setFrame({5, 40, 390, 300});
  EXPECT_EQ(frameOf(map), CGRect(15, 60, 300, 200));
  const auto empty = viewWith<CHWorkoutDetailMapView>({}, {5, 5, 390, 300});
  EXPECT_EQ(frameOf(empty), CGRectZero);
}

TEST_F(MapTest, TheMapKeepsItsTraitsAndFollowsItsTitle) {
  const auto map = rowOf(outdoors())->_mapView;
  setTraits(map, UIAccessibilityTraitSelected | UIAccessibilityTraitImage);
  EXPECT_EQ(traitsOf(map),
            UIAccessibilityTraitSelected | UIAccessibilityTraitImage | UIAccessibilityTraitButton);
  map->_titleLabel->setText(string("Detour"));
  EXPECT_EQ(labelOf(map), "Detour");
  map->_titleLabel = nullptr;
  EXPECT_EQ(heard(map), Utterances{"selected, button, Shows the route on a larger map"});
}

TEST_F(MapTest, TheHintIsKept) {
  EXPECT_TRUE(activate(rowOf(outdoors())->_mapView));
  EXPECT_EQ(heard(window), Utterances{"Route, heading"});
}

TEST_F(MapTest, TheWeatherCoversItsPartsFromItsOwnOrigin) {
  const std::pair<std::vector<CGRect>, CGRect> cases[] = {
      {{{16, 8, 40, 40}, {64, 12, 100, 20}}, {0, 0, 164, 48}},
      {{{16, 8, 40, 40}}, {0, 0, 56, 48}},
      {{{-10, 8, 40, 40}, {0, -5, 5, 5}}, {-10, -5, 40, 53}},
      {{}, {0, 0, 0, 0}},
  };
  for (const auto& [parts, covered] : cases) {
    std::vector<Ref<UIView>> views;
    views.reserve(parts.size() + 1);
    for (const CGRect& frame : parts) {
      views.emplace_back(makeLabel("part", frame));
    }
    const auto button = makeView<UIButton>({300, 200, 40, 40});
    views.emplace_back(button);
    const auto weather = viewWith<CHWorkoutDetailWeatherView>(views, {0, 0, 390, 56});
    weather->_twcButton = button;
    const Ref<NSArray> elements = elementsOf(weather);
    ASSERT_EQ(elements->count(), 2U);
    EXPECT_EQ(frameOf((*elements)[0]), covered) << parts.size();
    EXPECT_EQ((*elements)[1], button);
    weather->setFrame({7, 100, 390, 56});
    EXPECT_EQ(frameOf((*elements)[0]).origin,
              (CGPoint{7 + covered.origin.x, 100 + covered.origin.y}));
  }
}

TEST_F(MapTest, OnlyTheWeathersOwnButtonIsLeftOutOfItsText) {
  const auto own = makeView<UIButton>({0, 0, 10, 10});
  own->setTitle(string("Source"));
  const auto twin = makeView<UIButton>({20, 0, 10, 10});
  twin->setTitle(string("Source"));
  const auto hidden = makeLabel("hidden so silent", {0, 0, 50, 50});
  hidden->setHidden(true);
  // In the order of the subviews, not of the places.
  const auto weather = viewWith<CHWorkoutDetailWeatherView>(
      {makeLabel("right", {60, 0, 10, 10}), own, makeLabel("left", {0, 0, 10, 10}), twin, hidden},
      {0, 0, 390, 56});
  weather->_twcButton = own;
  EXPECT_EQ(heard(weather), (Utterances{"right, left, Source", "Source, button"}));

  const auto withoutButton = viewWith<CHWorkoutDetailWeatherView>(
      {makeLabel("Clear", {0, 0, 10, 10}), twin}, {0, 0, 390, 56});
  withoutButton->_twcButton = nullptr;
  EXPECT_EQ(heard(withoutButton), Utterances{"Clear, Source"});
}

TEST_F(MapTest, TheWeatherIsSaidAsItWasUntilItsChildrenAreDropped) {
  const auto weather = rowOf(outdoors())->_weatherView;
  const Ref<NSArray> first = elementsOf(weather);
  weather->setWeather({"Rain", "4 °C", "90 %"});
  weather->_twcButton->setTitle(string("Another source"));
  load(weather);
  EXPECT_EQ(elementsOf(weather), first);
  EXPECT_EQ(heard(weather), (Utterances{"Clear, 9 °C, Humidity 50 %", "Another source, button"}));
  _accessibilitySetRetainedValue(weather.get(), nullptr, kUIAccessibilityStorageKeyChildren);
  EXPECT_EQ(heard(weather).front(), "Rain, 4 °C, Humidity 90 %");
}

}  // namespace
}  // namespace tavro
