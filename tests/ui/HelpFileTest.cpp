// The shipped help file of the chart control: plain UTF-8 text that covers what the control does.
#include <gtest/gtest.h>

#include <QFile>
#include <QStringDecoder>

#include "ui/UiSupport.h"

namespace kg::test {
namespace {

QString helpFileText(const QString& path, bool* validUtf8)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly)) return {};
    const QByteArray bytes = f.readAll();
    QStringDecoder decoder(QStringDecoder::Utf8);
    const QString text = decoder(bytes);
    *validUtf8 = !decoder.hasError();
    return text;
}

const QString kSourceFile = QStringLiteral(KG_TEST_DATA "/../../Help/chartctl.hlp");

TEST(HelpFile, IsPlainUtf8TextAndSaysSoAtTheTop)
{
    bool valid = false;
    const QString text = helpFileText(kSourceFile, &valid);
    ASSERT_FALSE(text.isEmpty()) << "missing: " << kSourceFile.toStdString();
    EXPECT_TRUE(valid);
    EXPECT_FALSE(text.contains(QChar(0)));
    const QString top = text.left(400);
    EXPECT_TRUE(top.contains("plain UTF-8 text")) << top.toStdString();
}

TEST(HelpFile, IsShippedBesideTheBuiltProgramsForTheTestStand)
{
    EXPECT_TRUE(QFile::exists(QStringLiteral(KG_BUILD_DIR "/Help/chartctl.hlp")));
}

struct TopicCase {
    const char* name;
    std::vector<const char*> words;
};

const TopicCase kTopics[] = {
    {"MenuWithShortcuts",
     {"Chart Settings", "F2", "Print Chart", "F8", "Close", "Ctrl+X", "Labels On", "F3", "Labels Off", "F4",
      "Redraw", "F5", "Mouse and Keys Help", "Ctrl+F1", "Advanced Chart Help", "F1", "Save As...", "Copy"}},
    {"MouseAndKeys",
     {"Ctrl", "Shift", "both mouse buttons", "middle button", "left mouse button", "mouse wheel", "Escape",
      "\"r\"", "Graphics zoom", "Axis zoom", "Rotate", "Scale", "Move", "tip"}},
    {"ChartTypes", {"Plot", "Bar", "Area", "Pie", "single series"}},
    {"View3D", {"Rotation", "Elevation", "Depth", "-45 to 45", "Show 3D Chart"}},
    {"LabelsAndLegend", {"Value labels", "Default - Labels ON", "legend"}},
    {"PrintingAndExport", {"landscape", "one page", "PNG", "SVG", "PDF", "clipboard"}},
};

struct Topic : ::testing::TestWithParam<TopicCase> {};

TEST_P(Topic, IsCovered)
{
    bool valid = false;
    const QString text = helpFileText(kSourceFile, &valid);
    for (const char* word : GetParam().words) EXPECT_TRUE(text.contains(word)) << word;
}

INSTANTIATE_TEST_SUITE_P(HelpFile, Topic, ::testing::ValuesIn(kTopics), byName);

}  // namespace
}  // namespace kg::test
