// karstgraph render: runs one request through the component exactly as a host would (the test
// stand's source form from a form file, the chart window offscreen) and writes what the window shows.
#include <QApplication>
#include <charconv>
#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

#include "apps/cli/Commands.h"
#include "apps/cli/RequestRunner.h"
#include "chart/control/render/ChartExport.h"
#include "requests/Services.h"
#include "core/Convert.h"
#include "core/Error.h"
#include "teststand/FaultPlan.h"
#include "teststand/TestStand.h"

namespace {

constexpr int kWritten = 0, kFailed = 1, kUsage = 2, kMessage = 3;

const char* const kUsageText =
    "usage: karstgraph render FORM.json REQUEST [--series N] [--total VALUE|empty] [--choice N]\n"
    "                         [--settings FILE.ini] [--jobs FILE.db] [--size WxH] [--fail OPERATION:N]\n"
    "                         -o OUT.png|OUT.svg|OUT.pdf\n"
    "  REQUEST   one of the thirteen GenerateChart_* requests, e.g. GenerateChart_PropGraph1\n"
    "  --series  lNumSeries (default: the grid's data rows)\n"
    "  --total   vTotal: a number, or 'empty' for an Empty total (default 0)\n"
    "  --choice  answer of the data choice dialog: 0 to 6, or -99 to cancel (measure requests only)\n"
    "  --jobs    the jobs database (default: the form file's \"jobsDatabase\")\n"
    "  --fail    the host fails the N-th call of OPERATION, e.g. Grid.textmatrix:3 or Settings.WriteSetting:1\n"
    "            (repeatable; operations as kind.member: AppServices, Settings, JobData, Form, Grid,\n"
    "            Picker, List, Factory)\n"
    "exit status: 0 chart written, 1 request failed, 2 bad usage or input, 3 a message instead of a chart\n";

struct PlannedFailure {
    std::string operation;
    int call = 0;
};

struct Options {
    std::string form, output, settings, jobs;
    std::vector<PlannedFailure> failures;
    kg::cli::RequestCall call;
    int width = 800, height = 600;
};

int usage(const std::string& problem)
{
    std::fprintf(stderr, "karstgraph render: %s\n%s", problem.c_str(), kUsageText);
    return kUsage;
}

template <class T>
bool parseWhole(const char* text, T& out)
{
    const char* end = text + std::strlen(text);
    auto [p, ec] = std::from_chars(text, end, out);
    return ec == std::errc() && p == end;
}

// Returns an exit status when the arguments are unusable.
std::optional<int> parse(int argc, char** argv, Options& o)
{
    int positional = 0;
    for (int i = 0; i < argc; ++i) {
        const std::string a = argv[i];
        auto value = [&]() -> const char* { return i + 1 < argc ? argv[++i] : nullptr; };
        if (a == "-o" || a == "--output") {
            const char* v = value();
            if (!v) return usage("-o needs a file name");
            o.output = v;
        } else if (a == "--series") {
            const char* v = value();
            int32_t n = 0;
            if (!v || !parseWhole(v, n)) return usage("--series needs a 32-bit whole number");
            o.call.series = n;
        } else if (a == "--total") {
            const char* v = value();
            if (!v) return usage("--total needs a number or 'empty'");
            if (std::strcmp(v, "empty") == 0) {
                o.call.total = kg::Variant();
            } else {
                try {
                    o.call.total = kg::Variant(kg::toDouble(kg::Variant(v)));
                } catch (const kg::Error&) {
                    return usage(std::string("--total is not a number: ") + v);
                }
            }
        } else if (a == "--choice") {
            const char* v = value();
            int16_t n = 0;
            if (!v || !parseWhole(v, n) || !((n >= 0 && n <= 6) || n == kg::kChoiceCancelled))
                return usage("--choice takes 0 to 6, or -99");
            o.call.choice = n;
        } else if (a == "--settings" || a == "--jobs") {
            const char* v = value();
            if (!v) return usage(a + " needs a file name");
            (a == "--jobs" ? o.jobs : o.settings) = v;
        } else if (a == "--fail") {
            const char* v = value();
            const char* colon = v ? std::strrchr(v, ':') : nullptr;
            int n = 0;
            if (!colon || colon == v || !std::strchr(v, '.') || !parseWhole(colon + 1, n) || n < 1)
                return usage("--fail takes OPERATION:N, e.g. Grid.textmatrix:3, with N from 1");
            o.failures.push_back({std::string(v, colon), n});
        } else if (a == "--size") {
            const char* v = value();
            int w = 0, h = 0;
            char x = 0, rest = 0;
            if (!v || std::sscanf(v, "%d%c%d%c", &w, &x, &h, &rest) != 3 || x != 'x' || w < 16 || h < 16 ||
                w > 16384 || h > 16384)
                return usage("--size takes WxH, each from 16 to 16384 pixels");
            o.width = w;
            o.height = h;
        } else if (!a.empty() && a[0] == '-') {
            return usage("unknown option " + a);
        } else if (positional == 0) {
            o.form = a, ++positional;
        } else if (positional == 1) {
            o.call.request = a, ++positional;
        } else {
            return usage("unexpected argument " + a);
        }
    }
    if (o.form.empty() || o.call.request.empty()) return usage("a form file and a request are needed");
    if (o.output.empty()) return usage("-o OUT.png|OUT.svg|OUT.pdf is needed");
    if (!kg::control::isExportFormat(o.output)) return usage("the output must end in .png, .svg or .pdf: " + o.output);
    if (!kg::cli::isRequestName(o.call.request)) return usage("unknown request " + o.call.request);
    if (kg::cli::isMeasureRequest(o.call.request) && !o.call.choice)
        return usage(o.call.request + " needs --choice N for its data choice");
    return std::nullopt;
}

}  // namespace

int runRender(int argc, char** argv)
{
    Options o;
    if (auto status = parse(argc, argv, o)) return *status;

    // The window is made offscreen: rendering needs no display.
    qputenv("QT_QPA_PLATFORM", "offscreen");
    int qtArgc = 1;
    char name[] = "karstgraph";
    char* qtArgv[] = {name, nullptr};
    QApplication app(qtArgc, qtArgv);

    kg::teststand::Config stand;
    if (!o.settings.empty()) stand.settingsFile = o.settings;
    kg::Ref<kg::Object> form;
    try {
        form = kg::teststand::loadFormFile(o.form);
    } catch (const kg::Error& e) {
        std::fprintf(stderr, "karstgraph render: %s\n", e.description().c_str());
        return kUsage;
    }
    stand.jobsDatabase = !o.jobs.empty() ? o.jobs : kg::teststand::jobsDatabaseOf(form);

    kg::cli::installOffscreenComponent(stand);
    for (const PlannedFailure& f : o.failures) kg::teststand::FaultPlan::failOn(f.operation, f.call);
    const kg::cli::RequestResult result = kg::cli::runRequest(kg::Variant(form), o.call);
    struct Shutdown {
        ~Shutdown() { kg::cli::shutdownComponent(); }
    } shutdown;
    switch (result.outcome) {
    case kg::cli::Outcome::Failed:
        std::fprintf(stderr, "karstgraph render: %s failed: %s\n", o.call.request.c_str(), result.text.c_str());
        return kFailed;
    case kg::cli::Outcome::Message: std::fprintf(stderr, "%s\n", result.text.c_str()); return kMessage;
    case kg::cli::Outcome::Drawn: break;
    }
    try {
        kg::cli::writeShownChart(o.output, QSize(o.width, o.height));
    } catch (const kg::Error& e) {
        std::fprintf(stderr, "karstgraph render: %s\n", e.description().c_str());
        return kFailed;
    }
    return kWritten;
}
