#include "ui/HelpText.h"

#include <QTextCursor>
#include <QTextDocument>
#include <QTextList>
#include <vector>

namespace kg::ui {

namespace {

constexpr const char* kFontFamily = "Arial";
constexpr double kPointSize = 8;

// One interaction: its bold heading and the numbered steps under it.
struct Interaction {
    const char* heading;
    std::vector<const char*> steps;
};

const char* const kTitle = "Interacting with the Chart";

const char* const kIntroduction =
    "The mouse and key actions below act on the chart inside the chart area only; the other elements of the "
    "chart, such as the header, the footer and the legend, stay as they are. Resting the mouse pointer on a "
    "bar, point or pie slice shows a tip with its series, its point and its value.";

const char* const kZoomKinds =
    "There are two ways of zooming. Graphics zoom enlarges the selected area of the chart as a picture; the "
    "axes are not necessarily shown. Axis zoom changes the minimum and maximum of the axes to the values of the "
    "selected area and redraws that data with its axes.";

const char* const kSpecialNotes = "Special Notes";

const char* const kNotes[] = {
    "A programmer can change or remove the key and mouse combinations, so not all of them may be enabled in "
    "every chart.",
    "Scaling, moving or graphics zooming the chart sets the margins of the plot area; from then on the margins "
    "no longer follow other chart properties automatically. Resetting the chart (see below) hands them back.",
};

const std::vector<Interaction>& interactions()
{
    static const std::vector<Interaction> list = {
        {"To Scale the Chart:",
         {"Hold down the Ctrl key.",
          "Press both mouse buttons (or the middle button) with the mouse pointer inside the chart area.",
          "Move the mouse down to enlarge the chart, or up to shrink it.",
          "Release the mouse buttons and the Ctrl key.",
          "Turning the mouse wheel while holding down the Ctrl key scales the chart as well."}},
        {"To Move the Chart:",
         {"Hold down the Shift key.",
          "Press both mouse buttons (or the middle button) with the mouse pointer inside the chart area.",
          "Move the mouse: the chart follows it inside the chart area.",
          "Release the mouse buttons and the Shift key."}},
        {"To Graphics Zoom an Area of the Chart:",
         {"Hold down the Ctrl key.",
          "Press the left mouse button at one corner of the area to enlarge.",
          "Drag the mouse to the opposite corner; a rectangle marks the area.",
          "Release the mouse button: the area fills the chart area. Pressing Escape before releasing cancels "
          "the zoom."}},
        {"To Axis Zoom the Chart:",
         {"Hold down the Shift key.",
          "Press the left mouse button at one corner of the area to show.",
          "Drag the mouse to the opposite corner; a rectangle marks the area.",
          "Release the mouse button: the axes take the values of the area as their minimum and maximum, their "
          "tick values are worked out anew and the data is redrawn. Pressing Escape before releasing cancels "
          "the zoom."}},
        {"To Rotate the Chart (Bar/Pie charts displaying 3D effect only):",
         {"Press both mouse buttons (or the middle button) inside the chart area, without holding down a key.",
          "Move the mouse up or down to change the elevation (the inclination) of the 3-D view.",
          "On bar charts, move the mouse left or right to change the rotation angle.",
          "Release the mouse buttons. Rotation and elevation stay within -45 to 45 degrees."}},
        {"To Reset to Automatic Scale and Position:",
         {"Press the \"r\" key while the chart has the keyboard focus.",
          "All scaling, moving and zooming is removed, and the chart takes control of the plot area margins "
          "again."}},
    };
    return list;
}

QTextCharFormat textFormat(bool bold)
{
    QTextCharFormat format;
    format.setFontFamilies({QString(kFontFamily)});
    format.setFontPointSize(kPointSize);
    format.setFontWeight(bold ? QFont::Bold : QFont::Normal);
    return format;
}

QTextBlockFormat paragraphFormat(double spaceBefore)
{
    QTextBlockFormat format;
    format.setTopMargin(spaceBefore);
    format.setBottomMargin(2);
    return format;
}

}  // namespace

void buildChartHelp(QTextDocument& document)
{
    document.clear();
    document.setDefaultFont(QFont(kFontFamily, int(kPointSize)));
    const QTextCharFormat plain = textFormat(false);
    const QTextCharFormat bold = textFormat(true);
    QTextCursor cursor(&document);

    // The document's first block holds the title; every later block is inserted after it.
    cursor.setBlockFormat(paragraphFormat(0));
    cursor.setBlockCharFormat(bold);
    cursor.insertText(kTitle, bold);
    auto paragraph = [&](const char* text, const QTextCharFormat& format, double spaceBefore) {
        cursor.insertBlock(paragraphFormat(spaceBefore), format);
        cursor.insertText(QString::fromUtf8(text), format);
    };
    auto list = [&](const auto& items, QTextListFormat::Style style) {
        QTextListFormat format;
        format.setStyle(style);
        format.setIndent(1);
        bool first = true;
        for (const char* item : items) {
            // Items are close together; later items inherit the first one's list and spacing.
            if (first) {
                cursor.insertBlock(paragraphFormat(0), plain);
                cursor.createList(format);
            } else {
                cursor.insertBlock();
            }
            cursor.insertText(QString::fromUtf8(item), plain);
            first = false;
        }
    };

    paragraph(kIntroduction, plain, 6);
    paragraph(kZoomKinds, plain, 6);
    paragraph(kSpecialNotes, bold, 6);
    list(kNotes, QTextListFormat::ListDisc);
    for (const Interaction& interaction : interactions()) {
        paragraph(interaction.heading, bold, 8);
        list(interaction.steps, QTextListFormat::ListDecimal);
    }
}

}  // namespace kg::ui
