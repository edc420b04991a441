#pragma once

#include <string>

namespace tavro {

/// Whether the language of the settings' locale reads from right to left.
bool userInterfaceIsRightToLeft();
/// Whether ICU knows the language of a locale name ("de_DE").
bool isKnownLocale(const std::string& name);
/// A locale as its own speakers call it ("Deutsch (Deutschland)").
std::string nameOfLocale(const std::string& name);
/// Whether ICU knows a time zone of that name ("Europe/Lisbon").
bool isKnownTimeZone(const std::string& name);

}  // namespace tavro
