#pragma once

#include "host/Diary.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

/// A route drawn over a map, as large as the view allows.
class WorkoutRouteImageView : public UIImageView {
 public:
  static constexpr Name className = "WorkoutRouteImageView";

  /// Once for a view.
  void setPoints(const std::vector<RoutePoint>& points);
  void layoutSubviews();

 private:
  std::vector<RoutePoint> points_;
  std::vector<Ref<CALayer>> marks_;
};

/// A workout's route with its title below. The map is inset; the view itself is as wide as its row.
/// A tap shows the route on a screen of its own.
class CHWorkoutDetailMapView : public UIView {
 public:
  static constexpr Name className = "CHWorkoutDetailMapView";

  Ref<UILabel> _titleLabel;

  id init();
  void setRoute(const Route& route);
  bool naturalActivate();
  void layoutSubviews();

 private:
  Route route_;
  Ref<WorkoutRouteImageView> mapImageView_;
};

/// The weather of a workout: a picture of the sky, figures, and a button that leads to where they
/// are from.
class CHWorkoutDetailWeatherView : public UIView {
 public:
  static constexpr Name className = "_CHWorkoutDetailWeatherView";

  Ref<UIImageView> _weatherConditionImageView;
  Ref<UIButton> _twcButton;

  id init();
  void setWeather(const Weather& weather);

 private:
  Ref<UILabel> temperatureLabel_;
  Ref<UILabel> humidityLabel_;
};

/// The row of the map and the weather; either may be absent, and is nil then.
class CHWorkoutDetailMapAndWeatherTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHWorkoutDetailMapAndWeatherTableViewCell";
  static constexpr double height = 300;

  Ref<CHWorkoutDetailMapView> _mapView;
  Ref<CHWorkoutDetailWeatherView> _weatherView;

  /// Once for a row.
  void setWorkout(const Workout& workout);
  void layoutSubviews();
};

/// A new row for that workout, as high as the row's class says; nil when it has neither a route nor
/// weather. Keeps nothing of the workout.
Ref<UIView> mapAndWeatherRow(const Workout& workout);

}  // namespace tavro
