#include "host/ActivityFile.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <numbers>
#include <pugixml.hpp>
#include <string_view>
#include <utility>

#include "platform/foundation/NSDate.h"
#include "platform/foundation/TextFile.h"

namespace tavro {
namespace {

constexpr double kEarthRadius = 6371008.8;  // metres, the mean
constexpr double kSplitLength = 1000;
constexpr double kShortestSplit = 1;  // what is left of a split below it counts to the one before
constexpr double kLongestDistance = 1e8;
constexpr double kFastestHeart = 255;
constexpr double kMostEnergy = 1e6;
constexpr std::string_view kBlanks = " \t\r\n";

/// Degrees.
struct Position {
  double latitude = 0;
  double longitude = 0;
};

struct TrackPoint {
  double seconds = 0;  ///< since 1970
  std::optional<Position> position;
  std::optional<double> distance;  ///< metres since the start, as the file has it
  std::optional<double> heartRate;
  bool startsSegment = false;  ///< nothing is known of the way here from the point before
};

/// What either format tells.
struct Recording {
  std::string type;
  std::string title;
  std::string source;
  double energy = 0;
  std::vector<TrackPoint> points;  ///< in the order of time, never empty once read
};

struct NamedType {
  std::string_view name;
  HKWorkoutActivityType type;
};
/// What the formats and those who write them call the activities, in lower case.
constexpr NamedType kTypes[] = {
    {"running", HKWorkoutActivityType::running},
    {"run", HKWorkoutActivityType::running},
    {"trail_running", HKWorkoutActivityType::running},
    {"cycling", HKWorkoutActivityType::cycling},
    {"biking", HKWorkoutActivityType::cycling},
    {"ride", HKWorkoutActivityType::cycling},
    {"hiking", HKWorkoutActivityType::hiking},
    {"hike", HKWorkoutActivityType::hiking},
    {"walking", HKWorkoutActivityType::walking},
    {"walk", HKWorkoutActivityType::walking},
    {"swimming", HKWorkoutActivityType::swimming},
    {"swim", HKWorkoutActivityType::swimming},
    {"yoga", HKWorkoutActivityType::yoga},
};

std::string_view trimmed(std::string_view text) {
  const std::size_t start = text.find_first_not_of(kBlanks);
  return start == std::string_view::npos
             ? std::string_view()
             : text.substr(start, text.find_last_not_of(kBlanks) - start + 1);
}

/// The beginning of a text, on one line, for an error message.
std::string excerpt(std::string_view text) {
  constexpr std::size_t kMostBytes = 40;
  std::string_view start = text.substr(0, text.find_first_of("\t\r\n"));
  std::size_t end = std::min(start.size(), kMostBytes);
  while (end < start.size() && (static_cast<unsigned char>(start[end]) & 0xC0U) == 0x80U) {
    --end;  // never within a character
  }
  start = start.substr(0, end);
  return std::string(start) + (start.size() < text.size() ? "..." : "");
}

std::string_view localName(std::string_view name) { return name.substr(name.find(':') + 1); }

pugi::xml_node child(const pugi::xml_node& node, std::string_view name) {
  return node.find_child(
      [name](const pugi::xml_node& each) { return localName(each.name()) == name; });
}

/// The next sibling of the same local name.
pugi::xml_node next(const pugi::xml_node& node) {
  pugi::xml_node each = node.next_sibling();
  while (each && localName(each.name()) != localName(node.name())) {
    each = each.next_sibling();
  }
  return each;
}

pugi::xml_node descendant(const pugi::xml_node& node, std::string_view name) {
  return node.find_node(
      [name](const pugi::xml_node& each) { return localName(each.name()) == name; });
}

std::string_view textOf(const pugi::xml_node& node) { return trimmed(node.text().get()); }

pugi::xml_attribute attribute(const pugi::xml_node& node, std::string_view name) {
  return node.find_attribute(
      [name](const pugi::xml_attribute& each) { return localName(each.name()) == name; });
}

std::optional<double> numberIn(std::string_view text) {
  text.remove_prefix(text.starts_with('+') ? 1 : 0);
  double number = 0;
  const char* const end = text.data() + text.size();
  const auto [stop, error] = std::from_chars(text.data(), end, number);
  return error == std::errc() && stop == end ? std::optional(number) : std::nullopt;
}

/// Seconds east of UTC of "Z", "+02:00" or nothing, which means UTC.
std::optional<double> secondsOfZone(std::string_view zone) {
  constexpr std::size_t kLength = 6;
  if (zone.empty() || zone == "Z") {
    return 0;
  }
  if (zone.size() != kLength || (zone[0] != '+' && zone[0] != '-')) {
    return std::nullopt;
  }
  // The zone is as many hours and minutes as a clock would show.
  const auto clock = secondsFromIso("1970-01-01T" + std::string(zone.substr(1)) + "Z");
  return clock && zone[0] == '-' ? std::optional(-*clock) : clock;
}

/// The moment of an XML time: seconds may have decimals, and a time zone may follow. Nothing for
/// what is none, or lies outside the years 1970 to 9999.
std::optional<double> secondsInTime(std::string_view text) {
  constexpr std::size_t kWholeSeconds = std::string_view("2026-03-02T08:15:30").size();
  if (text.size() < kWholeSeconds) {
    return std::nullopt;
  }
  const auto whole = secondsFromIso(std::string(text.substr(0, kWholeSeconds)) + "Z");
  std::string_view rest = text.substr(kWholeSeconds);
  std::optional<double> decimals = 0;
  if (rest.starts_with('.')) {
    const std::size_t end = std::min(rest.find_first_not_of("0123456789", 1), rest.size());
    decimals = numberIn("0" + std::string(rest.substr(0, end)) + "0");
    rest.remove_prefix(end);
  }
  const std::optional<double> zone = secondsOfZone(rest);
  if (!whole || !decimals || !zone) {
    return std::nullopt;
  }
  const double seconds = *whole + *decimals - *zone;
  const auto last = static_cast<double>(daysFromCivil(10000, 1, 1) * 86400);
  return seconds >= 0 && seconds < last ? std::optional(seconds) : std::nullopt;
}

/// "2026-03-02T08:15:30Z"; what is left of a second is dropped.
std::string isoText(double seconds) {
  using namespace std::chrono;
  const sys_seconds moment{std::chrono::seconds(static_cast<std::int64_t>(seconds))};
  const auto midnight = floor<days>(moment);
  const year_month_day date(midnight);
  const hh_mm_ss time(moment - midnight);
  std::array<char, 64> text{};
  std::snprintf(text.data(), text.size(), "%04d-%02u-%02uT%02d:%02d:%02dZ",
                static_cast<int>(date.year()), static_cast<unsigned>(date.month()),
                static_cast<unsigned>(date.day()), static_cast<int>(time.hours().count()),
                static_cast<int>(time.minutes().count()), static_cast<int>(time.seconds().count()));
  return text.data();
}

/// Reads both formats; every fault names the line of the element that it is in.
class ActivityReader {
 public:
  explicit ActivityReader(const std::string& path) : file_(path) {}

  Recording read() {
    if (trimmed(file_.text()).empty()) {
      file_.fail(0, "the file is empty");
    }
    pugi::xml_document document;
    const pugi::xml_parse_result result = document.load_buffer(
        file_.text().data(), file_.text().size(), pugi::parse_default, pugi::encoding_utf8);
    if (result.status == pugi::status_no_document_element) {
      file_.fail(0, "there is no XML in the file");
    }
    if (!result) {
      file_.fail(static_cast<std::size_t>(result.offset),
                 "the XML is malformed: " + std::string(result.description()));
    }
    const pugi::xml_node root = document.document_element();
    const std::string_view format = localName(root.name());
    if (format != "gpx" && format != "TrainingCenterDatabase") {
      fail(root, "the file is neither GPX nor TCX: its root is <" + excerpt(root.name()) + ">");
    }
    Recording recording = format == "gpx" ? readGpx(root) : readTcx(root);
    if (recording.points.empty()) {
      fail(root, "there are no track points in the file");
    }
    return recording;
  }

 private:
  [[noreturn]] void fail(const pugi::xml_node& node, const std::string& reason) const {
    file_.fail(static_cast<std::size_t>(std::max<std::ptrdiff_t>(node.offset_debug(), 0)), reason);
  }

  double number(const pugi::xml_node& node, const std::string& name, std::string_view text,
                double least, double most) const {
    const std::optional<double> read = numberIn(text);
    // Written so that what is not a number is refused too.
    if (!read || !(*read >= least && *read <= most)) {
      std::array<char, 64> range{};
      std::snprintf(range.data(), range.size(), "%.0f to %.0f", least, most);
      fail(node, name + " is \"" + excerpt(text) + "\", which is no number from " + range.data());
    }
    return *read;
  }

  /// Nothing when the element is not there.
  std::optional<double> element(const pugi::xml_node& node, double least, double most) const {
    return node ? std::optional(
                      number(node, "<" + std::string(node.name()) + ">", textOf(node), least, most))
                : std::nullopt;
  }

  Position position(const pugi::xml_node& node, std::string_view latitude,
                    std::string_view longitude) const {
    constexpr double kPole = 90;
    constexpr double kDateLine = 180;
    return {number(node, "the latitude", latitude, -kPole, kPole),
            number(node, "the longitude", longitude, -kDateLine, kDateLine)};
  }

  /// The part of a track point that both formats share: its moment.
  TrackPoint pointAt(const pugi::xml_node& node, const pugi::xml_node& time,
                     const std::vector<TrackPoint>& before) const {
    if (!time) {
      fail(node, "the track point has no time");
    }
    const std::optional<double> seconds = secondsInTime(textOf(time));
    if (!seconds) {
      fail(time, "\"" + excerpt(textOf(time)) + "\" is no time like 2026-03-02T08:15:30Z");
    }
    if (!before.empty() && *seconds < before.back().seconds) {
      fail(time, "the track point lies before the one that it follows");
    }
    TrackPoint point;
    point.seconds = *seconds;
    return point;
  }

  Recording readGpx(const pugi::xml_node& root) const {
    const pugi::xml_node track = child(root, "trk");
    Recording recording;
    recording.type = textOf(child(track, "type"));
    recording.title = textOf(child(track, "name"));
    recording.source = trimmed(attribute(root, "creator").value());
    for (auto segment = child(track, "trkseg"); segment; segment = next(segment)) {
      bool isFirst = true;
      for (auto node = child(segment, "trkpt"); node; node = next(node)) {
        TrackPoint point = pointAt(node, child(node, "time"), recording.points);
        point.position = position(node, trimmed(attribute(node, "lat").value()),
                                  trimmed(attribute(node, "lon").value()));
        point.heartRate = element(descendant(child(node, "extensions"), "hr"), 0, kFastestHeart);
        point.startsSegment = std::exchange(isFirst, false);
        recording.points.push_back(point);
      }
    }
    return recording;
  }

  Recording readTcx(const pugi::xml_node& root) const {
    const pugi::xml_node activity = descendant(root, "Activity");
    Recording recording;
    recording.type = trimmed(attribute(activity, "Sport").value());
    recording.source = textOf(child(child(activity, "Creator"), "Name"));
    for (auto lap = child(activity, "Lap"); lap; lap = next(lap)) {
      recording.energy += element(child(lap, "Calories"), 0, kMostEnergy).value_or(0);
      for (auto track = child(lap, "Track"); track; track = next(track)) {
        for (auto node = child(track, "Trackpoint"); node; node = next(node)) {
          TrackPoint point = pointAt(node, child(node, "Time"), recording.points);
          if (const pugi::xml_node place = child(node, "Position")) {
            point.position = position(place, textOf(child(place, "LatitudeDegrees")),
                                      textOf(child(place, "LongitudeDegrees")));
          }
          point.distance = element(child(node, "DistanceMeters"), 0, kLongestDistance);
          point.heartRate = element(child(child(node, "HeartRateBpm"), "Value"), 0, kFastestHeart);
          recording.points.push_back(point);
        }
      }
    }
    return recording;
  }

  const TextFile file_;
};

double radians(double degrees) { return degrees * std::numbers::pi / 180; }

/// Metres along the surface of the earth.
double distanceBetween(const Position& from, const Position& to) {
  const auto halfChord = [](double angle) { return std::pow(std::sin(angle / 2), 2); };
  const double latitudes = halfChord(radians(to.latitude - from.latitude));
  const double longitudes = halfChord(radians(to.longitude - from.longitude));
  const double chord =
      latitudes + std::cos(radians(from.latitude)) * std::cos(radians(to.latitude)) * longitudes;
  return 2 * kEarthRadius * std::asin(std::min(1.0, std::sqrt(chord)));
}

/// The distance at each point as the file has it; empty when it has none, or one that falls.
std::vector<double> recordedDistances(const std::vector<TrackPoint>& points) {
  std::vector<double> distances;
  bool isRecorded = false;
  double reached = 0;
  for (const TrackPoint& point : points) {
    if (point.distance && *point.distance < reached) {
      return {};
    }
    isRecorded = isRecorded || point.distance;
    reached = point.distance.value_or(reached);
    distances.push_back(reached);
  }
  return isRecorded ? distances : std::vector<double>();
}

/// The distance at each point, from one position to the next of its segment; empty when there are
/// no positions.
std::vector<double> reckonedDistances(const std::vector<TrackPoint>& points) {
  std::vector<double> distances;
  bool isKnown = false;
  double reached = 0;
  std::optional<Position> last;
  for (const TrackPoint& point : points) {
    if (point.startsSegment) {
      last.reset();
    }
    if (point.position) {
      reached += last ? distanceBetween(*last, *point.position) : 0;
      last = point.position;
      isKnown = true;
    }
    distances.push_back(reached);
  }
  return isKnown ? distances : std::vector<double>();
}

/// Each kilometre and the rest. Between two points the pace is taken to be even. Nothing for a
/// distance that there is not, or that nobody could cover.
std::vector<Split> splitsOf(const std::vector<TrackPoint>& points,
                            const std::vector<double>& distances) {
  if (distances.empty() || distances.back() > kLongestDistance) {
    return {};
  }
  std::vector<Split> splits;
  double start = points.front().seconds;
  double begun = 0;
  for (std::size_t index = 1; index < distances.size(); ++index) {
    const TrackPoint& before = points[index - 1];
    while (distances[index] - begun >= kSplitLength) {
      begun += kSplitLength;
      const double step = distances[index] - distances[index - 1];
      const double share = step > 0 ? std::max(0.0, (begun - distances[index - 1]) / step) : 0;
      const double moment = before.seconds + share * (points[index].seconds - before.seconds);
      splits.push_back({kSplitLength, moment - start});
      start = moment;
    }
  }
  const Split rest{distances.back() - begun, points.back().seconds - start};
  if (rest.distance >= kShortestSplit) {
    splits.push_back(rest);
  } else if (!splits.empty()) {
    splits.back().distance += rest.distance;
    splits.back().duration += rest.duration;
  }
  return splits;
}

std::vector<HeartRateReading> readingsOf(const std::vector<TrackPoint>& points) {
  std::vector<HeartRateReading> readings;
  for (const TrackPoint& point : points) {
    const double offset = point.seconds - points.front().seconds;
    const bool isLater = readings.empty() || offset > readings.back().offset;
    if (point.heartRate.value_or(0) > 0 && isLater) {
      readings.push_back({offset, *point.heartRate});
    }
  }
  return readings;
}

std::optional<Route> routeOf(const Recording& recording) {
  constexpr double kFullTurn = 360;
  Route route;
  route.title = recording.title.empty() ? "Route" : recording.title;
  std::optional<Position> first;
  for (const TrackPoint& point : recording.points) {
    if (point.position) {
      first = first.value_or(*point.position);
      // The short way round, also across the date line.
      const double turn = std::remainder(point.position->longitude - first->longitude, kFullTurn);
      route.points.push_back({radians(turn) * kEarthRadius * std::cos(radians(first->latitude)),
                              radians(point.position->latitude - first->latitude) * kEarthRadius});
    }
  }
  return first ? std::optional(std::move(route)) : std::nullopt;
}

HKWorkoutActivityType typeNamed(std::string_view name) {
  std::string lower(name);
  std::ranges::transform(lower, lower.begin(), [](char letter) {
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
  });
  const auto* const found = std::ranges::find(kTypes, lower, &NamedType::name);
  return found == std::end(kTypes) ? HKWorkoutActivityType::other : found->type;
}

}  // namespace

Workout readActivityFile(const std::string& path) {
  const Recording recording = ActivityReader(path).read();
  const std::vector<TrackPoint>& points = recording.points;
  std::vector<double> distances = recordedDistances(points);
  if (distances.empty()) {
    distances = reckonedDistances(points);
  }
  Workout workout;
  workout.type = typeNamed(recording.type);
  workout.start.iso = isoText(points.front().seconds);
  workout.duration = points.back().seconds - points.front().seconds;
  workout.energy = recording.energy;
  workout.source.name = recording.source;
  if (!distances.empty()) {
    workout.distance = distances.back();
  }
  workout.heartRate = readingsOf(points);
  workout.splits = splitsOf(points, distances);
  workout.route = routeOf(recording);
  workout.isImported = true;
  return workout;
}

}  // namespace tavro
