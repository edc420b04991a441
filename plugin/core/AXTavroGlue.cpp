#include "platform/accessibility/SafeCategory.h"
#include "platform/runtime/Dispatch.h"

namespace tavro {
namespace {

/// The categories in the order of their installation.
constexpr std::string_view kCategories[] = {
    "CHListSummaryTableViewCellAccessibility",
    "CHAchievementsCellContentViewAccessibility",
    "TrendPairTableViewCellAccessibility",
    "DayViewActivityRingsTableViewCellAccessibility",
    "TrendDetailDailyAverageViewAccessibility",
    "TrendDetailChartViewAccessibility",
    "TrendDetailSummaryViewAccessibility",
    "TrendListHeaderViewAccessibility",
    "TrendingDownTableViewCellAccessibility",
    "TrendListMetricViewAccessibility",
    "DayViewStandChartTableViewCellAccessibility",
    "ActivityStandChartViewAccessibility",
    "DayViewMoveAndExerciseChartTableViewCellAccessibility",
    "ActivityMoveAndExerciseChartViewAccessibility",
    "CHFriendListCompetitionTableViewCellAccessibility",
    "CHNoHeartRateDataViewControllerAccessibility",
    "CHFriendInboxTableViewControllerAccessibility",
    "CHFriendListViewControllerAccessibility",
    "CHWorkoutDetailHeartRateChartTableViewCellAccessibility",
    "CHWorkoutDetailHeartRateChartViewAccessibility",
    "CHFriendListTableViewCellAccessibility",
    "CHAchievementsSectionHeaderViewAccessibility",
    "CHWorkoutsListTableViewCellAccessibility",
    "CHFriendInboxBarButtonViewAccessibility",
    "CHFriendDetailCollectionViewControllerAccessibility",
    "CHFriendDetailActionCellAccessibility",
    "CHFriendDetailGoalCellAccessibility",
    "CHAchievementCollectionViewCellAccessibility",
    "_CHWorkoutDetailWeatherViewAccessibility",
    "CHWorkoutDetailMapViewAccessibility",
    "CHWorkoutDetailExpandingHeaderViewAccessibility",
    "CHListTableHeaderViewAccessibility",
    "_CHWorkoutSummaryTabbedLabelContainerAccessibility",
    "PaletteViewControllerAccessibility",
    "CHWorkoutDetailMapAndWeatherTableViewCellAccessibility",
    "CHWorkoutDetailTwoValueTableViewCellAccessibility",
    "CHWorkoutDetailPaceTableViewCellAccessibility",
    "CHWorkoutDetailSplitTableViewCellAccessibility",
    "CHWorkoutFormattingManagerAccessibility",
    "_TavroMonthTitleLabelAccessibility",
    "TavroUIScrollViewAccessibility",
    "MonthScrollViewControllerAccessibility",
    "LoadingViewAccessibility",
    "CHAchievementDetailViewControllerAccessibility",
    "TavroUIButtonAccessibility",
    "MonthViewControllerAccessibility",
    "MonthDayCellLayerAccessibility",
    "MonthWeekViewAccessibility",
    "PaletteWeekdayHeaderViewAccessibility",
    "WeekPaletteTappableDayAccessibility",
    "AX_TavroNSStringAccessibility",
    "CHASActivitySetupGoalViewAccessibility",
    "CHASActivitySetupViewControllerAccessibility",
};

/// What the plug-in needs of the process as a whole.
constexpr HostCheck kProcessContract[] = {
    classMethod("NSCalendar", "hk_gregorianCalendarWithUTCTimeZone", "@"),
    instanceMethod("ActivitySummaryCache", "activitySummaryForCacheIndex:", "@", "q"),
    instanceMethod("HKActivitySummary", "_exerciseTimeCompletionPercentage", "d"),
};

bool checkProcess(const id& manager) {
  if (const auto validating = as<AXValidationManager>(manager)) {
    for (const HostCheck& check : kProcessContract) {
      validating->validate(check);
    }
  }
  return true;
}

bool configureRun(const id& manager) {
  const Ref<NSString> name = string("AX Tavro");
  send<void>(manager, "setValidationTargetName:", name);
  send<void>(manager, "setOverrideProcessName:", name);
  send<void>(manager, "setDebugBuild:", false);
  return AXPerformValidationChecks();
}

void installCategories(const id& installer) {
  for (const std::string_view category : kCategories) {
    send<void>(installer, "installSafeCategory:canInteractWithTargetClass:", string(category),
               true);
  }
}

/// The bundle's principal class.
class AXTavroGlue : public NSObject {
 public:
  static constexpr Name className = "AXTavroGlue";

  static id accessibilityBundles(Class* /*self*/) { return nullptr; }

  static void accessibilityInitializeBundle(Class* /*self*/) {
    static OnceToken token;
    dispatchOnce(token, [] {
      const id manager = send<id>(Class::named("AXValidationManager"), "sharedInstance");
      send<void>(manager,
                 "performValidations:withPreValidationHandler:postValidationHandler:"
                 "safeCategoryInstallationHandler:",
                 ChecksHandler(&checkProcess), PreValidationHandler(&configureRun),
                 PostValidationHandler(), InstallationHandler(&installCategories));
    });
  }
};

const Registered glue =
    defineClass<AXTavroGlue, NSObject>()
        .classMethod<&AXTavroGlue::accessibilityBundles>("accessibilityBundles")
        .classMethod<&AXTavroGlue::accessibilityInitializeBundle>("accessibilityInitializeBundle");

}  // namespace
}  // namespace tavro
