#include "host/screens/workouts/MapAndWeather.h"

#include <algorithm>

namespace tavro {
namespace {

const Registered routeClass = defineClass<WorkoutRouteImageView, UIImageView>()
                                  .method<&WorkoutRouteImageView::layoutSubviews>("layoutSubviews");

using Map = CHWorkoutDetailMapView;
const Registered mapClass = defineClass<Map, UIView>()
                                .method<&Map::init>("init")
                                .method<&Map::naturalActivate>("_naturalAccessibilityActivate")
                                .method<&Map::layoutSubviews>("layoutSubviews")
                                .variable<&Map::_titleLabel>("_titleLabel");

using WeatherView = CHWorkoutDetailWeatherView;
const Registered weatherClass =
    defineClass<WeatherView, UIView>()
        .method<&WeatherView::init>("init")
        .variable<&WeatherView::_weatherConditionImageView>("_weatherConditionImageView")
        .variable<&WeatherView::_twcButton>("_twcButton");

using Cell = CHWorkoutDetailMapAndWeatherTableViewCell;
const Registered cellClass = defineClass<Cell, UITableViewCell>()
                                 .method<&Cell::layoutSubviews>("layoutSubviews")
                                 .variable<&Cell::_mapView>("_mapView")
                                 .variable<&Cell::_weatherView>("_weatherView");

constexpr double kMargin = 16;
constexpr double kTitleHeight = 28;
constexpr double kMark = 4;
constexpr double kWeatherHeight = 56;
/// More points than this could not be told apart on the screen.
constexpr std::size_t kMostPoints = 300;

constexpr CGRect kConditionFrame{16, 8, 40, 40};
constexpr CGRect kTemperatureFrame{64, 6, 100, 22};
constexpr CGRect kHumidityFrame{64, 28, 140, 22};
constexpr CGRect kButtonFrame{230, 6, 144, 44};

}  // namespace

void WorkoutRouteImageView::setPoints(const std::vector<RoutePoint>& points) {
  points_.clear();
  const std::size_t step = points.size() / kMostPoints + 1;
  for (std::size_t index = 0; index < points.size(); index += step) {
    points_.push_back(points[index]);
    marks_.push_back(tavro::make<CALayer>());
    layer()->addSublayer(marks_.back());
  }
  setNeedsLayout();
}

void WorkoutRouteImageView::layoutSubviews() {
  if (points_.empty()) {
    return;
  }
  const auto [west, east] = std::ranges::minmax(points_, {}, &RoutePoint::east);
  const auto [south, north] = std::ranges::minmax(points_, {}, &RoutePoint::north);
  // One scale for both directions, so that the route keeps its shape.
  const double extent = std::max({east.east - west.east, north.north - south.north, 1.0});
  const double scale = (std::min(frame().size.width, frame().size.height) - kMark) / extent;
  for (std::size_t index = 0; index < points_.size(); ++index) {
    marks_[index]->setFrame({(points_[index].east - west.east) * scale,
                             (north.north - points_[index].north) * scale, kMark, kMark});
  }
}

id CHWorkoutDetailMapView::init() {
  mapImageView_ = makeView<WorkoutRouteImageView>();
  _titleLabel = makeLabel("");
  addSubview(mapImageView_);
  addSubview(_titleLabel);
  return this;
}

void CHWorkoutDetailMapView::setRoute(const Route& route) {
  route_ = route;
  _titleLabel->setText(string(route.title));
  mapImageView_->setPoints(route.points);
}

bool CHWorkoutDetailMapView::naturalActivate() {
  UIWindow* const window = UIWindow::keyWindow();
  if (window == nullptr) {
    return false;
  }
  const auto map = makeView<WorkoutRouteImageView>();
  map->setPoints(route_.points);
  const auto screen = makeController<UIViewController>();
  screen->navigationItem()->title = string(route_.title);
  screen->setView(map);
  window->setRootViewController(screen);
  return true;
}

void CHWorkoutDetailMapView::layoutSubviews() {
  const double width = frame().size.width - 2 * kMargin;
  const double height = frame().size.height - kTitleHeight - kMargin;
  mapImageView_->setFrame({kMargin, kMargin, width, height});
  _titleLabel->setFrame({kMargin, kMargin + height, width, kTitleHeight});
}

id CHWorkoutDetailWeatherView::init() {
  _weatherConditionImageView = makeView<UIImageView>(kConditionFrame);
  temperatureLabel_ = makeLabel("", kTemperatureFrame);
  humidityLabel_ = makeLabel("", kHumidityFrame);
  _twcButton = makeView<UIButton>(kButtonFrame);
  _twcButton->setTitle(string("Weather Source"));
  // The page that it opens lies outside the application.
  _twcButton->setAction([] {});
  for (const Ref<UIView>& part : std::initializer_list<Ref<UIView>>{
           _weatherConditionImageView, temperatureLabel_, humidityLabel_, _twcButton}) {
    addSubview(part);
  }
  return this;
}

void CHWorkoutDetailWeatherView::setWeather(const Weather& weather) {
  const auto picture = tavro::make<UIImage>();
  picture->name = weather.condition;
  _weatherConditionImageView->setImage(picture);
  // Said by whoever reads the picture; the picture is no element by itself.
  send<void>(_weatherConditionImageView, "setAccessibilityLabel:", string(weather.condition));
  temperatureLabel_->setText(string(weather.temperature));
  humidityLabel_->setText(string("Humidity " + weather.humidity));
}

void CHWorkoutDetailMapAndWeatherTableViewCell::setWorkout(const Workout& workout) {
  if (workout.route) {
    _mapView = makeView<CHWorkoutDetailMapView>();
    _mapView->setRoute(*workout.route);
    addSubview(_mapView);
  }
  if (workout.weather) {
    _weatherView = makeView<CHWorkoutDetailWeatherView>();
    _weatherView->setWeather(*workout.weather);
    addSubview(_weatherView);
  }
}

void CHWorkoutDetailMapAndWeatherTableViewCell::layoutSubviews() {
  const CGSize size = frame().size;
  const double weatherHeight = _weatherView ? kWeatherHeight : 0;
  if (_mapView) {
    _mapView->setFrame({0, 0, size.width, size.height - weatherHeight});
  }
  if (_weatherView) {
    const double top = _mapView ? size.height - weatherHeight : 0;
    _weatherView->setFrame({0, top, size.width, weatherHeight});
  }
}

Ref<UIView> mapAndWeatherRow(const Workout& workout) {
  if (!workout.route && !workout.weather) {
    return nullptr;
  }
  auto row = makeView<CHWorkoutDetailMapAndWeatherTableViewCell>();
  row->setWorkout(workout);
  return row;
}

}  // namespace tavro
