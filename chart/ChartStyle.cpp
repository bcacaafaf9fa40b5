#include "chart/ChartStyle.h"

#include "core/Convert.h"
#include "core/Dispatch.h"

namespace kg::chartstyle {

namespace {
Variant ownerOf(const Variant& appServices)
{
    Args owner{Variant(std::string())};
    call(appServices, "GetSettingsOwner", owner);
    return owner[0];
}
}  // namespace

std::optional<control::ChartType> typeOfName(const std::string& name)
{
    for (const StyleName& s : kStyleNames)
        if (name == s.name) return s.type;
    return std::nullopt;
}

std::string read(const Variant& appServices, const Variant& settings, Key key)
{
    const KeyInfo& k = infoOf(key);
    Args args{Variant(kSection), Variant(k.name), Variant(k.defaultValue), ownerOf(appServices),
              Variant(std::string())};
    call(settings, "ReadSetting", args);
    return toText(args[4]);
}

void write(const Variant& appServices, const Variant& settings, Key key, const std::string& value)
{
    writeAs(settings, ownerOf(appServices), key, value);
}

void writeAs(const Variant& settings, const Variant& owner, Key key, const std::string& value)
{
    Args args{Variant(kSection), Variant(infoOf(key).name), Variant(value), owner, Variant()};
    call(settings, "WriteSetting", args);
}

}  // namespace kg::chartstyle
