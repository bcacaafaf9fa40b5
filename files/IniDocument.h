#pragma once
// An INI file as sections of lines: read from a file's bytes, looked up, changed and written back,
// each line not changed written as it was read.
//
//   IniDocument doc = IniDocument::parse(bytes, IniDocument::Syntax::Lines);
//   if (IniDocument::Section* s = doc.find("ProgID\\Other.Chart")) { auto clsid = doc.value(*s, "CLSID"); }
//   doc.appendSection("Mine").append("Key", "value");
//   bytes = doc.serialize();
//
// The document knows sections, keys and raw values; what a name or a value means (escapes, key
// paths) is for the file's owner to say.
#include <QByteArray>
#include <QByteArrayView>
#include <QList>
#include <optional>
#include <vector>

namespace kg::files {

class IniDocument {
public:
    enum class Syntax {
        // One line is one line: a section header is a line that is [name] once trimmed, a key line
        // splits at its first =, key and value trimmed; lines starting ; or # are comments. Names
        // and keys match regardless of case. The registration file's: hand-edited by others, kept.
        Lines,
        // QSettings' IniFormat: a quoted value or an escaped line end continues the line, ; starts
        // a comment (after a value, too), a line starting [ names a section up to its ], a key line
        // splits at its first = outside quotes; a UTF-8 byte order mark at the start is skipped.
        // Names and keys match as written. Comments and blank lines are not kept.
        IniFormat,
    };

    struct Line {
        QByteArray text;        // as written, without the line end
        qsizetype equals = -1;  // where the key ends; -1 for a line without a key
    };
    struct Section {
        QByteArray name;    // between the brackets; empty for the lines before the first header
        QList<Line> lines;  // for a named section the header first, then the lines up to the next one

        Section& append(const QByteArray& key, const QByteArray& value);  // a key line at the end
        Section& appendBlank();                                           // a blank line at the end
    };

    explicit IniDocument(Syntax syntax) : syntax_(syntax), sections_(1) {}
    static IniDocument parse(QByteArrayView bytes, Syntax syntax);
    // Every line followed by "\n".
    QByteArray serialize() const;

    // sections()[0] holds the lines before the first header.
    std::vector<Section>& sections() { return sections_; }
    const std::vector<Section>& sections() const { return sections_; }

    // The first named section of that name.
    Section* find(QByteArrayView name);
    // A key line's key (blanks at its end dropped; Lines: at both ends) and raw value (Lines:
    // trimmed; IniFormat: up to the line end, quotes and escapes left for the owner).
    QByteArray key(const Line& line) const;
    QByteArray value(const Line& line) const;
    // The value of the first line of `key` in `section`.
    std::optional<QByteArray> value(const Section& section, QByteArrayView key) const;
    bool isComment(const Line& line) const;

    // A named section at the end, its header "[name]".
    Section& appendSection(const QByteArray& name);
    // Replaces the first line of `key` in `section`, else appends one.
    void setValue(Section& section, const QByteArray& key, const QByteArray& value);
    // Drops a named section but not the comments in it: they may well introduce the section that
    // follows, so they stay with the section before.
    void removeSection(size_t index);

private:
    bool sameName(QByteArrayView a, QByteArrayView b) const;

    Syntax syntax_;
    std::vector<Section> sections_;
};

}  // namespace kg::files
