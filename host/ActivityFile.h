#pragma once

#include <string>

#include "host/Diary.h"

namespace tavro {

/// Reads a recorded activity as a workout that is marked as imported: GPX (heart rate in the track
/// points' extensions) or TCX, UTF-8, told apart by the root element; names are matched whatever
/// their namespace prefixes are. Of several tracks or activities the first counts.
///
/// The duration lasts from the first track point to the last, pauses included. The distance is the
/// file's own where its points carry one that never falls, else it is reckoned between the
/// positions of each segment; nothing where there is neither. Splits are kilometres and the rest.
/// The route's points are metres from its first position, on a plane. A heart rate of 0 is no
/// reading, and of several at one moment the first counts. The energy is what the laps say, else 0.
///
/// Throws a `FileError`, one sentence with file, line and reason, for a file that cannot be read,
/// is neither format or is broken XML; that has no track points; and for a track point without a
/// time, with a number or a time that is none, or before the one that it follows.
Workout readActivityFile(const std::string& path);

}  // namespace tavro
