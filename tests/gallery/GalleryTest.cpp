// The headless main job: `karstgraph gallery` writes every chart of the sample data as PNG, SVG and
// PDF with an index that shows them all. Run as a user would, as a separate process.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QImage>
#include <QProcess>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <QXmlStreamReader>

namespace {

QString tool() { return QStringLiteral(KG_BUILD_DIR) + "/bin/karstgraph"; }

struct Gallery : ::testing::Test {
    static inline QTemporaryDir* dir = nullptr;
    static inline QString output;
    static inline int exitCode = -1;

    static void SetUpTestSuite()
    {
        dir = new QTemporaryDir;
        QProcess p;
        QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
        env.insert("QT_QPA_PLATFORM", "offscreen");
        env.insert("XDG_CONFIG_HOME", dir->filePath("config"));  // the user's files stay untouched
        p.setProcessEnvironment(env);
        p.start(tool(), {"gallery", dir->filePath("gallery")});
        p.waitForFinished(120000);
        exitCode = p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -1;
        output = QString::fromUtf8(p.readAllStandardOutput());
    }
    static void TearDownTestSuite() { delete dir; }
    static QString file(const QString& name) { return dir->filePath("gallery/" + name); }
};

TEST_F(Gallery, WritesEveryChartAndSaysWhere)
{
    ASSERT_EQ(exitCode, 0) << output.toStdString();
    EXPECT_TRUE(output.contains("chart 1 of 39")) << output.toStdString();
    EXPECT_TRUE(output.contains("chart 39 of 39"));
    EXPECT_TRUE(output.contains(file("index.html")));
    QFile index(file("index.html"));
    ASSERT_TRUE(index.open(QIODevice::ReadOnly));
    const QString html = QString::fromUtf8(index.readAll());
    EXPECT_EQ(html.count("<img "), 39);
    for (const char* request : {"GenerateChart_HourlyGraph1", "GenerateChart_ServCatSumm, choice 6",
                                "GenerateChart_JobStatusReport", "Pie 3-D"})
        EXPECT_TRUE(html.contains(request)) << request;
}

TEST_F(Gallery, EveryFileIsWholeAndValid)
{
    ASSERT_EQ(exitCode, 0);
    for (int i = 1; i <= 39; ++i) {
        const QString base = QString("chart-%1").arg(i, 2, 10, QChar('0'));
        const QImage png(file(base + ".png"));
        EXPECT_EQ(png.size(), QSize(800, 600)) << base.toStdString();

        QFile svg(file(base + ".svg"));
        ASSERT_TRUE(svg.open(QIODevice::ReadOnly)) << base.toStdString();
        QXmlStreamReader xml(&svg);
        QStringList texts;
        while (!xml.atEnd())
            if (xml.readNext() == QXmlStreamReader::Characters) texts << xml.text().toString();
        EXPECT_FALSE(xml.hasError()) << base.toStdString() << ": " << xml.errorString().toStdString();
        EXPECT_FALSE(texts.isEmpty()) << base.toStdString();

        QFile pdf(file(base + ".pdf"));
        ASSERT_TRUE(pdf.open(QIODevice::ReadOnly)) << base.toStdString();
        const QByteArray bytes = pdf.readAll();
        EXPECT_TRUE(bytes.startsWith("%PDF-")) << base.toStdString();
        EXPECT_TRUE(bytes.trimmed().endsWith("%%EOF")) << base.toStdString();
    }
}

TEST_F(Gallery, ChartsCarryTheirHeaders)
{
    ASSERT_EQ(exitCode, 0);
    // The first chart is HourlyGraph1: its SVG holds the header with the grid's real total.
    QFile svg(file("chart-01.svg"));
    ASSERT_TRUE(svg.open(QIODevice::ReadOnly));
    const QString text = QString::fromUtf8(svg.readAll());
    EXPECT_TRUE(text.contains(QRegularExpression("Qty of Bookings: Total =  [0-9]+"))) << "header missing";
    QFile jobs(file("chart-31.svg"));
    ASSERT_TRUE(jobs.open(QIODevice::ReadOnly));
    EXPECT_TRUE(QString::fromUtf8(jobs.readAll()).contains("Tavix Job Status Chart"));
}

// `karstgraph render` on the gallery's sample form, with host failures planned by --fail: the
// request fails with the injected description, nothing is written, and the same request without
// the plan charts.
struct RenderCase {
    const char* name;
    QStringList options;
    int exitCode;
    const char* says;  // on standard error
};

class Render : public Gallery, public ::testing::WithParamInterface<RenderCase> {};

TEST_P(Render, FailsAsPlannedOrCharts)
{
    ASSERT_EQ(exitCode, 0);
    const RenderCase& c = GetParam();
    const QString out = dir->filePath(QString("render-%1.png").arg(c.name));
    QProcess p;
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    env.insert("XDG_CONFIG_HOME", dir->filePath("config"));
    p.setProcessEnvironment(env);
    p.start(tool(), QStringList{"render", file("sample/form.json"), "GenerateChart_HourlyGraph1", "-o", out,
                                "--settings", dir->filePath("render.ini")} + c.options);
    ASSERT_TRUE(p.waitForFinished(60000));
    const QString err = QString::fromUtf8(p.readAllStandardError());
    EXPECT_EQ(p.exitCode(), c.exitCode) << err.toStdString();
    EXPECT_TRUE(err.contains(c.says)) << err.toStdString();
    EXPECT_EQ(QFile::exists(out), c.exitCode == 0);
}

INSTANTIATE_TEST_SUITE_P(
    Plans, Render,
    ::testing::Values(
        RenderCase{"noPlan", {}, 0, ""},
        RenderCase{"gridCell", {"--fail", "Grid.textmatrix:3"}, 1, "Injected failure of Grid.textmatrix (call 3)"},
        RenderCase{"settingsRead", {"--fail", "Settings.ReadSetting:1"}, 1,
                   "Injected failure of Settings.ReadSetting (call 1)"},
        // A plan on a call that never comes changes nothing.
        RenderCase{"callNeverMade", {"--fail", "Grid.textmatrix:1000000"}, 0, ""},
        RenderCase{"noCallNumber", {"--fail", "Grid.textmatrix"}, 2, "--fail takes OPERATION:N"},
        RenderCase{"callZero", {"--fail", "Grid.textmatrix:0"}, 2, "--fail takes OPERATION:N"},
        RenderCase{"noKind", {"--fail", "textmatrix:3"}, 2, "--fail takes OPERATION:N"}),
    [](const auto& info) { return std::string(info.param.name); });

}  // namespace
