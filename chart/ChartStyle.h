#pragma once
// The chart style the user keeps between charts: six keys of the settings section "2dCharts",
// read by InitChart, shown and stored by the style dialog, preset by the gallery. The host wants
// its owner text fetched anew (GetSettingsOwner) for every read and write, so each key costs two
// host calls, in that order.
//
//   const std::string style = chartstyle::read(appServices, settings, chartstyle::Key::Style);
#include <array>
#include <optional>
#include <string>

#include "chart/control/model/ChartControl.h"
#include "core/Variant.h"

namespace kg::chartstyle {

constexpr const char* kSection = "2dCharts";

enum class Key { View3D, Rotation, Elevation, Depth, Style, LabelsOnDefault };

struct KeyInfo {
    Key key;
    const char* name;
    const char* defaultValue;  // what a key never stored reads as
};
constexpr std::array<KeyInfo, 6> kKeys = {{
    {Key::View3D, "View3D", "1"},  // "1" 3-D on, "0" off
    {Key::Rotation, "Rotation", "10"},
    {Key::Elevation, "Elevation", "10"},
    {Key::Depth, "Depth", "10"},
    {Key::Style, "Style", "Bar"},             // a name of kStyleNames
    {Key::LabelsOnDefault, "LabelsOnDefault", "0"},  // "1" value labels on
}};
constexpr const KeyInfo& infoOf(Key key) { return kKeys[size_t(key)]; }

// The stored style names and their chart types, in the order of the dialog's options.
struct StyleName {
    const char* name;
    control::ChartType type;
};
constexpr std::array<StyleName, 4> kStyleNames = {{
    {"Plot", control::kPlot},
    {"Bar", control::kBar},
    {"Area", control::kArea},
    {"Pie", control::kPie},
}};
// The chart type of a stored name, matched exactly (case and blanks count); none for another text.
std::optional<control::ChartType> typeOfName(const std::string& name);

// `appServices` and `settings` are the host's objects (goAppServices, goSettings).
std::string read(const Variant& appServices, const Variant& settings, Key key);
void write(const Variant& appServices, const Variant& settings, Key key, const std::string& value);
// Writes for an owner already known (the gallery stores as the test stand's configured user).
void writeAs(const Variant& settings, const Variant& owner, Key key, const std::string& value);

}  // namespace kg::chartstyle
