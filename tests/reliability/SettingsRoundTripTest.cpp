// What WriteSetting stores, ReadSetting gives back exactly, and a later write of another entry
// keeps it so: under any owner the host may name (owners are sections of the settings file, so
// the names IniFormat gives a meaning of its own, "General" holding the keys without a section,
// must still be owners like any other), and for any text.
#include <QTemporaryDir>

#include "core/Convert.h"
#include "core/Error.h"
#include "host/HostObjects.h"
#include "support/RequestFixture.h"

namespace kg {
namespace {

namespace stand = teststand;

class SettingsStore : public test::RequestFixture {
protected:
    std::string read(const Variant& settings, const std::string& owner, const std::string& key)
    {
        Args a{Variant("2dCharts"), Variant(key), Variant("<default>"), Variant(owner), Variant(std::string())};
        call(settings, "ReadSetting", a);
        return toText(a[4]);
    }
    void write(const Variant& settings, const std::string& owner, const std::string& key, const std::string& value)
    {
        Args a{Variant("2dCharts"), Variant(key), Variant(value), Variant(owner), Variant()};
        call(settings, "WriteSetting", a);
    }
};

struct EntryCase {
    const char* name;
    const char* owner;
    std::string value;
};

class SettingsEntry : public SettingsStore, public ::testing::WithParamInterface<EntryCase> {};

TEST_P(SettingsEntry, ReadsBackExactlyAndKeepsTheOtherOwners)
{
    const EntryCase& c = GetParam();
    const Variant settings(services->hostObjects->create(host::HostClass::Settings));
    write(settings, "Neighbour", "Style", "Area");
    write(settings, c.owner, "Style", c.value);
    EXPECT_EQ(read(settings, c.owner, "Style"), c.value);
    EXPECT_EQ(read(settings, "Neighbour", "Style"), "Area");
    // A write for a third owner rewrites the file: the entries must survive it.
    write(settings, "Other", "Style", "Bar");
    EXPECT_EQ(read(settings, c.owner, "Style"), c.value);
    EXPECT_EQ(read(settings, "Neighbour", "Style"), "Area");
}

// U+FEFF (a zero width no-break space, the byte order mark's character) as UTF-8.
const std::string kFeff = "\xEF\xBB\xBF";

INSTANTIATE_TEST_SUITE_P(
    Entries, SettingsEntry,
    ::testing::Values(EntryCase{"tavix", "Tavix", "Pie"}, EntryCase{"generalAsIniFormatWritesIt", "General", "Pie"},
                      EntryCase{"generalLowerCase", "general", "Pie"}, EntryCase{"generalUpperCase", "GENERAL", "Pie"},
                      EntryCase{"percentGeneral", "%General", "Pie"},
                      EntryCase{"blanksAndSigns", "Tavix Pty. Ltd. (AU) #2", "Pie"},
                      EntryCase{"nonLatinOwner", "\u30bf\u30d3\u30c3\u30af\u30b9", "Pie"},
                      EntryCase{"controlCharacters", "Tavix", std::string("a\0b\x01\t\r\n", 7)},
                      EntryCase{"zeroWidthNoBreakSpaceInside", "Tavix", "a" + kFeff + "b"},
                      EntryCase{"zeroWidthNoBreakSpaceFirst", "Tavix", kFeff + "b"},
                      EntryCase{"zeroWidthNoBreakSpaceAfterAnEscape", "Tavix", "\t" + kFeff + "b"}),
    [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace kg
