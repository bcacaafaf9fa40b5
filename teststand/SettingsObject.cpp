// goSettings: texts under owner/section/key in the settings file.
#include "teststand/SettingsFile.h"
#include "teststand/StandObject.h"
#include "teststand/StandObjects.h"

namespace kg::teststand {

namespace {

class SettingsObject final : public StandObject {
public:
    enum : DispId { kReadSetting = 1, kWriteSetting };

    explicit SettingsObject(const Config& cfg)
        : StandObject("Settings", "Settings", {{"ReadSetting", kReadSetting}, {"WriteSetting", kWriteSetting}}),
          file_(settingsFilePath(cfg))
    {
    }

protected:
    Variant run(DispId id, Args& args) override
    {
        expectArgs(args, 5, memberName(id));
        const std::string at = where(id);
        const std::string section = textArg(args, 0, at);
        const std::string key = textArg(args, 1, at);
        const std::string valueOrDefault = textArg(args, 2, at);
        const std::string owner = textArg(args, 3, at);
        const std::string path = settingsKey({{"owner", owner}, {"section", section}, {"key", key}}, at);
        if (id == kReadSetting) {
            args[4] = file_.read(path).value_or(valueOrDefault);
        } else {
            file_.write({{path, valueOrDefault}});
            args[4] = int32_t{0};
        }
        return {};
    }

private:
    SettingsFile file_;
};

}  // namespace

Ref<Object> makeSettings(const Config& cfg) { return makeRef<SettingsObject>(cfg); }

}  // namespace kg::teststand
