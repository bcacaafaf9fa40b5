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

namespace stand = host::teststand;

struct OwnerCase {
    const char* name;
    const char* owner;
};

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

class SettingsOwner : public SettingsStore, public ::testing::WithParamInterface<OwnerCase> {};

TEST_P(SettingsOwner, ReadsBackWhatWasWrittenAndKeepsTheOtherOwners)
{
    const Variant settings(host::hostObjectFactory()->create(host::HostClass::Settings));
    write(settings, "Neighbour", "Style", "Area");
    write(settings, GetParam().owner, "Style", "Pie");
    write(settings, GetParam().owner, "Rotation", " 30");
    EXPECT_EQ(read(settings, GetParam().owner, "Style"), "Pie");
    EXPECT_EQ(read(settings, GetParam().owner, "Rotation"), " 30");
    EXPECT_EQ(read(settings, "Neighbour", "Style"), "Area");
    // A write for a third owner rewrites the file: the owner's entries must survive it.
    write(settings, "Other", "Style", "Bar");
    EXPECT_EQ(read(settings, GetParam().owner, "Style"), "Pie");
    EXPECT_EQ(read(settings, "Neighbour", "Style"), "Area");
}

INSTANTIATE_TEST_SUITE_P(Owners, SettingsOwner,
                         ::testing::Values(OwnerCase{"tavix", "Tavix"}, OwnerCase{"generalAsIniFormatWritesIt", "General"},
                                           OwnerCase{"generalLowerCase", "general"},
                                           OwnerCase{"generalUpperCase", "GENERAL"},
                                           OwnerCase{"percentGeneral", "%General"},
                                           OwnerCase{"blanksAndSigns", "Tavix Pty. Ltd. (AU) #2"},
                                           OwnerCase{"nonLatin", "\u30bf\u30d3\u30c3\u30af\u30b9"}),
                         [](const auto& info) { return std::string(info.param.name); });

struct ValueCase {
    const char* name;
    std::string value;
};

class SettingsValue : public SettingsStore, public ::testing::WithParamInterface<ValueCase> {};

TEST_P(SettingsValue, ReadsBackExactlyAfterOtherWrites)
{
    const Variant settings(host::hostObjectFactory()->create(host::HostClass::Settings));
    write(settings, "Tavix", "Note", GetParam().value);
    EXPECT_EQ(read(settings, "Tavix", "Note"), GetParam().value);
    write(settings, "Tavix", "Style", "Bar");
    EXPECT_EQ(read(settings, "Tavix", "Note"), GetParam().value);
}

// U+FEFF (a zero width no-break space, the byte order mark's character) as UTF-8.
const std::string kFeff = "\xEF\xBB\xBF";

INSTANTIATE_TEST_SUITE_P(Values, SettingsValue,
                         ::testing::Values(ValueCase{"plain", "Pie"}, ValueCase{"numberText", " 10"},
                                           ValueCase{"quotesAndSeparators", "a \"b\"; c, d = e\\f"},
                                           ValueCase{"controlCharacters", std::string("a\0b\x01\t\r\n", 7)},
                                           ValueCase{"leadingAt", "@Invalid()"},
                                           ValueCase{"nonLatin", "\u00e9t\u00e9 \u4e2d\u6587"},
                                           ValueCase{"zeroWidthNoBreakSpaceInside", "a" + kFeff + "b"},
                                           ValueCase{"zeroWidthNoBreakSpaceFirst", kFeff + "b"},
                                           ValueCase{"zeroWidthNoBreakSpaceAfterAnEscape", "\t" + kFeff + "b"}),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace kg
