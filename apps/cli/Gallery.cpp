// karstgraph gallery: every chart the demo offers, drawn from the bundled sample data through the
// component exactly as the windows show them, written as PNG, SVG and PDF with an index.html.
#include <QApplication>
#include <QDir>
#include <QFile>
#include <cstdio>
#include <string>
#include <vector>

#include "apps/cli/Commands.h"
#include "apps/cli/RequestRunner.h"
#include "chart/ChartStyle.h"
#include "core/Convert.h"
#include "core/Error.h"
#include "files/WholeFile.h"
#include "requests/Services.h"
#include "teststand/SampleData.h"
#include "teststand/TestStand.h"

namespace {

struct Style {
    const char* type = "Bar";  // as stored: Plot, Bar, Area, Pie
    bool view3D = true;
    bool labels = false;
    std::string text() const
    {
        return std::string(type) + (view3D ? ", 3-D" : ", flat") + (labels ? ", value labels" : "");
    }
};

struct Chart {
    std::string title;
    kg::cli::RequestCall call;
    Style style;
};

std::vector<Chart> galleryCharts(const kg::teststand::SampleTotals& totals)
{
    std::vector<Chart> charts;
    auto grid = [&](const char* request, double total) {
        Chart c{request, {request, std::nullopt, kg::Variant(total), std::nullopt}, {}};
        charts.push_back(c);
    };
    for (const char* family : {"HourlyGraph", "PropGraph", "YearlyRpt"}) {
        grid((std::string("GenerateChart_") + family + "1").c_str(), totals.quantity);
        grid((std::string("GenerateChart_") + family + "2").c_str(), totals.value);
        grid((std::string("GenerateChart_") + family + "3").c_str(), totals.average);
    }
    for (const char* request : {"GenerateChart_BookingsReport", "GenerateChart_SalesDeclaration",
                                "GenerateChart_ServCatSumm"})
        for (int16_t choice = 0; choice <= 6; ++choice)
            charts.push_back({std::string(request) + ", choice " + std::to_string(choice),
                              {request, std::nullopt, kg::Variant(), choice}, {}});
    charts.push_back({"GenerateChart_JobStatusReport", {"GenerateChart_JobStatusReport", {}, kg::Variant(), {}}, {}});
    for (const kg::chartstyle::StyleName& name : kg::chartstyle::kStyleNames)
        for (bool view3D : {false, true}) {
            const char* type = name.name;
            Style style{type, view3D, true};
            const bool pie = name.type == kg::control::kPie;
            const char* request = pie ? "GenerateChart_BookingsReport" : "GenerateChart_PropGraph1";
            kg::cli::RequestCall call{request, std::nullopt, kg::Variant(totals.quantity),
                                      pie ? std::optional<int16_t>(1) : std::nullopt};
            charts.push_back({std::string(type) + (view3D ? " 3-D" : " flat") + ": " + request, call, style});
        }
    return charts;
}

void storeStyle(const Style& style)
{
    kg::Variant settings(kg::services().hostObjects->create(kg::host::HostClass::Settings));
    const kg::Variant owner(kg::teststand::Config().settingsOwner);
    using kg::chartstyle::Key;
    auto write = [&](Key key, const std::string& value) { kg::chartstyle::writeAs(settings, owner, key, value); };
    write(Key::View3D, kg::numberText(style.view3D ? 1.0 : 0.0));
    write(Key::Rotation, kg::numberText(20.0));
    write(Key::Elevation, kg::numberText(15.0));
    write(Key::Depth, kg::numberText(10.0));
    write(Key::Style, style.type);
    write(Key::LabelsOnDefault, style.labels ? "1" : "0");
}

std::string html(const std::string& s)
{
    std::string out;
    for (char c : s) {
        switch (c) {
        case '<': out += "&lt;"; break;
        case '>': out += "&gt;"; break;
        case '&': out += "&amp;"; break;
        case '"': out += "&quot;"; break;
        default: out += c;
        }
    }
    return out;
}

struct Entry {
    std::string title, style, file, error;
};

void writeIndex(const std::string& folder, const std::vector<Entry>& entries)
{
    std::string page =
        "<!DOCTYPE html>\n<html><head><meta charset=\"utf-8\"><title>KarstGraph gallery</title>\n"
        "<style>body{font-family:sans-serif;background:#f4f4f4;margin:24px}"
        ".chart{display:inline-block;vertical-align:top;background:#fff;margin:8px;padding:8px;"
        "box-shadow:0 1px 3px #999;width:560px}.chart img{width:560px}.error{color:#b00}</style></head><body>\n"
        "<h1>KarstGraph gallery</h1><p>Every chart of the sample data, as the chart window shows it.</p>\n";
    for (const Entry& e : entries) {
        page += "<div class=\"chart\"><h3>" + html(e.title) + "</h3><p>Style: " + html(e.style) + "</p>";
        if (e.error.empty())
            page += "<img src=\"" + e.file + ".png\" alt=\"" + html(e.title) + "\"><p><a href=\"" + e.file +
                    ".svg\">SVG</a> | <a href=\"" + e.file + ".pdf\">PDF</a> | <a href=\"" + e.file +
                    ".png\">PNG</a></p>";
        else
            page += "<p class=\"error\">" + html(e.error) + "</p>";
        page += "</div>\n";
    }
    page += "</body></html>\n";
    const std::string path = folder + "/index.html";
    if (const auto failure = kg::files::writeWholeFile(QString::fromStdString(path),
                                                       QByteArray::fromStdString(page), kg::files::Sync::None))
        throw kg::Error(kg::errc::PathFileAccess, "Cannot write " + path + ": " + failure->reason.toStdString());
}

}  // namespace

int runGallery(int argc, char** argv)
{
    if (argc != 1 || argv[0][0] == '-') {
        std::fprintf(stderr, "usage: karstgraph gallery OUTDIR\n");
        return 2;
    }
    const std::string folder = QDir(QString::fromLocal8Bit(argv[0])).absolutePath().toStdString();
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    int qtArgc = 1;
    char name[] = "karstgraph";
    char* qtArgv[] = {name, nullptr};
    QApplication app(qtArgc, qtArgv);

    kg::teststand::SampleData sample;
    kg::Ref<kg::Object> form;
    kg::teststand::Config stand;
    try {
        sample = kg::teststand::writeSampleData(folder + "/sample");
        stand.settingsFile = folder + "/sample/settings.ini";
        QFile::remove(QString::fromStdString(stand.settingsFile));
        stand.jobsDatabase = sample.database;
        form = kg::teststand::loadFormFile(sample.form);
    } catch (const kg::Error& e) {
        std::fprintf(stderr, "karstgraph gallery: %s\n", e.description().c_str());
        return 1;
    }
    kg::cli::installOffscreenComponent(stand);

    const std::vector<Chart> charts = galleryCharts(sample.totals);
    std::vector<Entry> entries;
    int failures = 0;
    for (size_t i = 0; i < charts.size(); ++i) {
        const Chart& c = charts[i];
        std::printf("chart %zu of %zu: %s\n", i + 1, charts.size(), c.title.c_str());
        std::fflush(stdout);
        char file[32];
        std::snprintf(file, sizeof file, "chart-%02zu", i + 1);
        Entry entry{c.title, c.style.text(), file, {}};
        try {
            storeStyle(c.style);
            const kg::cli::RequestResult r = kg::cli::runRequest(kg::Variant(form), c.call);
            if (r.outcome != kg::cli::Outcome::Drawn) throw kg::Error(kg::errc::InvalidProcedureCall, r.text);
            for (const char* ext : {".png", ".svg", ".pdf"})
                kg::cli::writeShownChart(folder + "/" + file + ext, QSize(800, 600));
        } catch (const kg::Error& e) {
            entry.error = e.description();
            ++failures;
            std::fprintf(stderr, "  failed: %s\n", e.description().c_str());
        }
        entries.push_back(entry);
    }
    kg::cli::shutdownComponent();
    try {
        writeIndex(folder, entries);
    } catch (const kg::Error& e) {
        std::fprintf(stderr, "karstgraph gallery: %s\n", e.description().c_str());
        return 1;
    }
    std::printf("%zu charts (%d failed) written to %s/index.html\n", charts.size(), failures, folder.c_str());
    return failures ? 1 : 0;
}
