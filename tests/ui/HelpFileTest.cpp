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

struct TopicCase {
    const char* name;
    std::vector<const char*> words;
};

// A few key phrases per topic: enough to show the topic is there, not a copy of its wording.
const TopicCase kTopics[] = {
    {"MenuWithShortcuts", {"Chart Settings", "F2", "Advanced Chart Help", "Save As..."}},
    {"MouseAndKeys", {"Graphics zoom", "Axis zoom", "middle button", "Escape"}},
    {"ChartTypesAndView3D", {"Plot", "Pie", "Rotation", "-45 to 45"}},
    {"LabelsPrintingAndExport", {"Value labels", "legend", "landscape", "PDF", "clipboard"}},
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
