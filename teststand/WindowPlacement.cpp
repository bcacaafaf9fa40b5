#include "teststand/WindowPlacement.h"

#include <array>
#include <charconv>
#include <optional>

#include "core/Convert.h"
#include "core/Dispatch.h"

namespace kg::teststand {

namespace {

constexpr std::array<const char*, 5> kMembers = {"Left", "Top", "Width", "Height", "WindowState"};
constexpr int32_t kMaxTwips = 100000;

std::string keyOf(const std::string& key, const char* member)
{
    return settingsKey({{"group", "FormState"}, {"window key", key}, {"value", member}}, "FormState");
}

std::optional<int32_t> wholeNumber(const std::optional<std::string>& text)
{
    if (!text) return std::nullopt;
    int32_t n = 0;
    const char* end = text->data() + text->size();
    auto [ptr, ec] = std::from_chars(text->data(), end, n);
    if (ec != std::errc() || ptr != end) return std::nullopt;
    return n;
}

}  // namespace

void saveWindowPlacement(const SettingsFile& file, const Variant& window, const std::string& key)
{
    std::vector<std::pair<std::string, std::string>> entries;
    for (const char* member : kMembers)
        entries.emplace_back(keyOf(key, member), std::to_string(roundToLong(toDouble(call(window, member)))));
    file.write(entries);
}

void restoreWindowPlacement(const SettingsFile& file, const Variant& window, const std::string& key)
{
    std::array<int32_t, kMembers.size()> values{};
    for (size_t i = 0; i < kMembers.size(); ++i) {
        const std::optional<int32_t> v = wholeNumber(file.read(keyOf(key, kMembers[i])));
        if (!v) return;
        values[i] = *v;
    }
    const auto [left, top, width, height, state] = values;
    const bool sane = left >= -kMaxTwips && left <= kMaxTwips && top >= -kMaxTwips && top <= kMaxTwips &&
                      width > 0 && width <= kMaxTwips && height > 0 && height <= kMaxTwips && state >= 0 &&
                      state <= 2;
    if (!sane) return;
    put(window, "Left", left);
    put(window, "Top", top);
    put(window, "Width", width);
    put(window, "Height", height);
    put(window, "WindowState", state == 1 ? 0 : state);
}

}  // namespace kg::teststand
