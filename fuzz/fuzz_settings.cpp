// The settings file on any text: the test stand's INI reader, InitChart reading the stored chart
// style through the settings object, and the style dialog loading it (and, for some inputs,
// storing its choice with OK). Every refusal is kg::Error; a style read gives a chart type the
// control knows and 3-D angles the dialog can show; writing a file keeps every other entry as it
// was read (the reader and the writer agree on every text).
#include <QApplication>
#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <functional>
#include <map>

#include "chart/c2dChart.h"
#include "requests/modMain.h"
#include "core/Convert.h"
#include "FuzzSupport.h"
#include "teststand/RawIni.h"
#include "teststand/SettingsFile.h"
#include "teststand/TestStand.h"
#include "ui/NumericField.h"
#include "ui/frmChartSetup.h"

using namespace kg;
using kg::fuzz::expectOnly;
using kg::fuzz::require;
namespace stand = kg::teststand;
namespace rawini = kg::teststand::rawini;

namespace {

constexpr const char* kStyleKeys[] = {"View3D", "Rotation", "Elevation", "Depth", "Style", "LabelsOnDefault"};
const int32_t kSettingsError = errc::HostBase + stand::hosterr::Settings;

std::string settingsPath()
{
    static QTemporaryDir folder;  // removed at exit
    static const std::string path = folder.filePath(QStringLiteral("settings.ini")).toStdString();
    return path;
}

// Entries as the component sees them: UTF-8 texts (a lone surrogate from a hand-written escape
// is the same "?" before and after a write).
std::map<std::string, std::string> asTexts(const rawini::Entries& entries)
{
    std::map<std::string, std::string> texts;
    for (auto it = entries.constBegin(); it != entries.constEnd(); ++it)
        texts[it.key().toStdString()] = it.value().toStdString();
    return texts;
}

// The writer and the reader agree: what is read from a file, written and read again is the same.
void checkRoundTrip(const QByteArray& text)
{
    const rawini::Entries entries = rawini::entriesOf(text);
    const QByteArray written = rawini::fileTextOf(entries);
    const auto read = asTexts(entries), back = asTexts(rawini::entriesOf(written));
    if (back == read) return;
    for (const auto& [key, value] : read) {
        const auto b = back.find(key);
        require(b != back.end(), "the entry \"" + key + "\" is lost by a write; written:\n" + written.toStdString());
        require(b->second == value, "the entry \"" + key + "\" = \"" + value + "\" reads back as \"" + b->second + "\"");
    }
    kg::fuzz::fail("a write adds entries; written:\n" + written.toStdString());
}

bool knownChartType(int16_t t)
{
    return t == control::kPlot || t == control::kBar || t == control::kArea || t == control::kPie;
}

void initChart()
{
    auto control = makeRef<control::ChartControl>();
    c2dChart& chart = *modMain::goChart;
    chart.Initialize(control.get(), "Header", "", "Month", "Quantity");
    chart.setNumSeries(2);
    chart.setXMinData(1);
    chart.setXMaxData(12);
    chart.InitChart();
    require(knownChartType(chart.ChartType()), "InitChart chose chart type " + std::to_string(chart.ChartType()));
    require(chart.NumPoints() == 12, "InitChart changed the point count");
    if (!c2dChart::View3D())
        require(chart.Rotation() == 0 && chart.Elevation() == 0 && chart.Depth() == 0,
                "a 2-D chart kept its 3-D angles");
}

void styleDialog(bool pressOk)
{
    ui::frmChartSetup dialog;  // loads the stored style
    for (ui::NumericField* field : dialog.num3D) {
        const Variant v = field->Value();
        require(v.isNull() || (v.type() == VarType::Double && v.dbl() >= -45 && v.dbl() <= 45),
                "the style dialog shows an angle outside -45..45");
    }
    if (!pressOk) return;
    dialog.Command1_Click();
    // What OK stored reads back as the dialog showed it.
    const stand::SettingsFile file(settingsPath());
    const std::optional<std::string> style = file.read("Tavix/2dCharts/Style");
    require(style && (*style == "Plot" || *style == "Bar" || *style == "Area" || *style == "Pie"),
            "OK stored the style \"" + style.value_or("<nothing>") + "\"");
    require(file.read("Tavix/2dCharts/View3D") == numberText(double(dialog.chk3DValue())),
            "OK stored another View3D than the box shows");
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv)
{
    qputenv("QT_QPA_PLATFORM", "offscreen");
    static QApplication app(*argc, *argv);  // the style dialog is a widget
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const QByteArray text(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));
    checkRoundTrip(text);

    {
        QFile f(QString::fromStdString(settingsPath()));
        require(f.open(QIODevice::WriteOnly | QIODevice::Truncate) && f.write(text) == text.size(),
                "cannot write the settings file for the run");
    }
    const stand::SettingsFile file(settingsPath());
    for (const char* key : kStyleKeys)
        expectOnly({kSettingsError}, "SettingsFile::read", [&] { file.read(std::string("Tavix/2dCharts/") + key); });

    // The component's objects, as GraphInitialize makes them.
    stand::Config cfg;
    cfg.settingsFile = settingsPath();
    cfg.appFolder = QDir::tempPath().toStdString();
    Ref<host::HostObjectFactory> factory = stand::makeFactory(cfg);
    modMain::goAppServices = Variant(factory->create(host::HostClass::AppServices));
    modMain::goSettings = Variant(factory->create(host::HostClass::Settings));
    modMain::goChart = makeRef<c2dChart>([] { return modMain::goAppServices; }, [] { return modMain::goSettings; });

    expectOnly({kSettingsError}, "InitChart", initChart);
    const bool pressOk = std::hash<std::string>{}(text.toStdString()) % 16 == 0;
    expectOnly({kSettingsError}, "the style dialog", [&] { styleDialog(pressOk); });

    modMain::releaseSharedObjects();
    return 0;
}
