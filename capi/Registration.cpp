#include "capi/Registration.h"

#include <unistd.h>

#include <cctype>
#include <string_view>
#include <vector>

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSaveFile>

#include "core/Error.h"

namespace kg::registration {

namespace {

// The file as sections of raw lines, so that entries of others survive a rewrite as they were.
struct Section {
    std::string name;                // between the brackets; empty for the lines before the first section
    std::vector<std::string> lines;  // the header line (if any) and the lines up to the next section
};
using Document = std::vector<Section>;

std::string trimmed(std::string_view s)
{
    size_t b = 0, e = s.size();
    while (b < e && std::isspace(static_cast<unsigned char>(s[b]))) ++b;
    while (e > b && std::isspace(static_cast<unsigned char>(s[e - 1]))) --e;
    return std::string(s.substr(b, e - b));
}

std::optional<std::string> sectionNameOf(const std::string& line)
{
    const std::string t = trimmed(line);
    if (t.size() < 2 || t.front() != '[' || t.back() != ']') return std::nullopt;
    return trimmed(std::string_view(t).substr(1, t.size() - 2));
}

Document parse(const QByteArray& text)
{
    Document doc(1);
    size_t start = 0;
    const std::string all = text.toStdString();
    while (start < all.size()) {
        size_t end = all.find('\n', start);
        if (end == std::string::npos) end = all.size();
        std::string line = all.substr(start, end - start);
        if (!line.empty() && line.back() == '\r') line.pop_back();
        start = end + 1;
        if (auto name = sectionNameOf(line)) doc.push_back({*name, {}});
        doc.back().lines.push_back(std::move(line));
    }
    return doc;
}

QByteArray serialize(const Document& doc)
{
    std::string out;
    for (const Section& s : doc)
        for (const std::string& line : s.lines) out += line + "\n";
    return QByteArray::fromStdString(out);
}

Section* find(Document& doc, std::string_view name)
{
    for (size_t i = 1; i < doc.size(); ++i)
        if (equalsNoCase(doc[i].name, name)) return &doc[i];
    return nullptr;
}

std::optional<std::string> valueOf(const Section& s, std::string_view key)
{
    for (size_t i = 1; i < s.lines.size(); ++i) {
        const std::string& line = s.lines[i];
        const size_t eq = line.find('=');
        if (eq != std::string::npos && equalsNoCase(trimmed(std::string_view(line).substr(0, eq)), key))
            return trimmed(std::string_view(line).substr(eq + 1));
    }
    return std::nullopt;
}

bool isComment(const std::string& line)
{
    const std::string t = trimmed(line);
    return !t.empty() && (t.front() == ';' || t.front() == '#');
}

// Drops section i but not the comments in it: they may well introduce the section that follows.
void removeSection(Document& doc, size_t i)
{
    for (const std::string& line : doc[i].lines)
        if (isComment(line)) doc[i - 1].lines.push_back(line);
    doc.erase(doc.begin() + static_cast<std::ptrdiff_t>(i));
}

// Our section in place of an older one of the same name (duplicates dropped), else at the end.
void replaceOrAppend(Document& doc, Section ours)
{
    ours.lines.emplace_back();  // a blank line keeps the sections apart
    bool placed = false;
    for (size_t i = 1; i < doc.size();) {
        if (!equalsNoCase(doc[i].name, ours.name)) {
            ++i;
        } else if (!placed) {
            for (const std::string& line : doc[i].lines)
                if (isComment(line)) ours.lines.push_back(line);
            doc[i] = ours;
            placed = true;
            ++i;
        } else {
            removeSection(doc, i);
        }
    }
    if (placed) return;
    const Section& last = doc.back();
    if (!last.lines.empty() && !trimmed(last.lines.back()).empty()) doc.back().lines.emplace_back();
    doc.push_back(std::move(ours));
}

Error accessError(const std::string& file, const std::string& what)
{
    return Error(errc::PathFileAccess, "Path/File access error: registration file \"" + file + "\" " + what);
}

Document read(const std::string& file)
{
    QFile f(QString::fromStdString(file));
    if (!f.exists()) return Document(1);
    if (!f.open(QIODevice::ReadOnly)) throw accessError(file, "cannot be read: " + f.errorString().toStdString());
    const QByteArray text = f.readAll();
    if (f.error() != QFileDevice::NoError)
        throw accessError(file, "cannot be read: " + f.errorString().toStdString());
    return parse(text);
}

// A temporary file next to the old one, synced, then renamed over it: readers see the old file or
// the new one, never a part.
void write(const std::string& file, const Document& doc)
{
    const QString path = QString::fromStdString(file);
    const QString folder = QFileInfo(path).absolutePath();
    if (!QDir().mkpath(folder))
        throw accessError(file, "cannot be written: its folder \"" + folder.toStdString() + "\" cannot be created");
    QSaveFile f(path);
    const auto fail = [&](const std::string& step) {
        const std::string reason = f.errorString().toStdString();
        f.cancelWriting();
        return accessError(file, "cannot be written (" + step + "): " + reason);
    };
    if (!f.open(QIODevice::WriteOnly)) throw fail("open");
    const QByteArray bytes = serialize(doc);
    if (f.write(bytes) != bytes.size() || !f.flush()) throw fail("write");
    if (::fsync(f.handle()) != 0) throw fail("sync");
    if (!f.commit()) throw accessError(file, "cannot be written (rename): " + f.errorString().toStdString());
}

std::string classSectionName(const Guid& clsid) { return "CLSID\\" + guidText(clsid); }
std::string progIdSectionName(const std::string& progId) { return "ProgID\\" + progId; }

int hexValue(char c)
{
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

}  // namespace

std::string registryFilePath()
{
    const QString own = qEnvironmentVariable("KARSTGRAPH_REGISTRY");
    if (!own.isEmpty()) return own.toStdString();
    // A relative XDG_CONFIG_HOME is to be ignored, as the base directory rules say.
    QString config = qEnvironmentVariable("XDG_CONFIG_HOME");
    if (config.isEmpty() || QDir::isRelativePath(config)) config = QDir::homePath() + "/.config";
    return (config + "/karstgraph/registry.ini").toStdString();
}

void registerServer(const std::string& libraryPath, const std::string& file)
{
    if (libraryPath.empty() || libraryPath.front() != '/' || libraryPath.find_first_of("\r\n") != std::string::npos)
        throw Error::invalidCall("the library to register must be one absolute path, not \"" + libraryPath + "\"");
    Document doc = read(file);
    replaceOrAppend(doc, {classSectionName(kClsidTavixGraph),
                          {"[" + classSectionName(kClsidTavixGraph) + "]", std::string("ProgID=") + kProgId,
                           "InprocServer=" + libraryPath,
                           std::string("Interface=") + kInterfaceName + " " + guidText(kIidTavixGraph)}});
    replaceOrAppend(doc, {progIdSectionName(kProgId),
                          {"[" + progIdSectionName(kProgId) + "]", "CLSID=" + guidText(kClsidTavixGraph)}});
    write(file, doc);
}

void unregisterServer(const std::string& file)
{
    Document doc = read(file);
    const size_t before = doc.size();
    const std::string ourClass = classSectionName(kClsidTavixGraph);
    const std::string ourProgId = progIdSectionName(kProgId);
    for (size_t i = 1; i < doc.size();) {
        const Section& s = doc[i];
        bool ours = equalsNoCase(s.name, ourClass);
        // The programmatic name may meanwhile belong to another class: then it is not ours to remove.
        if (!ours && equalsNoCase(s.name, ourProgId)) {
            const std::optional<std::string> clsid = valueOf(s, "CLSID");
            const std::optional<Guid> g = clsid ? parseGuid(*clsid) : std::nullopt;
            ours = g && *g == kClsidTavixGraph;
        }
        if (ours)
            removeSection(doc, i);
        else
            ++i;
    }
    if (doc.size() != before) write(file, doc);
}

std::optional<ClassRegistration> findProgId(const std::string& progId, const std::string& file)
{
    Document doc = read(file);
    const Section* prog = find(doc, progIdSectionName(progId));
    if (!prog) return std::nullopt;
    const std::optional<std::string> clsidText = valueOf(*prog, "CLSID");
    if (!clsidText) return std::nullopt;
    const std::optional<Guid> clsid = parseGuid(*clsidText);
    if (!clsid)
        throw Error::typeMismatch("registration file \"" + file + "\": [" + prog->name + "] CLSID=" + *clsidText +
                                  " is not a class id");
    const Section* cls = find(doc, classSectionName(*clsid));
    if (!cls) return std::nullopt;
    const std::optional<std::string> library = valueOf(*cls, "InprocServer");
    if (!library || library->empty()) return std::nullopt;
    return ClassRegistration{*clsid, *library};
}

std::optional<Guid> parseGuid(const std::string& text)
{
    // {XXXXXXXX-XXXX-XXXX-XXXX-XXXXXXXXXXXX}: positions of the dashes, and hex digits everywhere else.
    if (text.size() != 38 || text.front() != '{' || text.back() != '}') return std::nullopt;
    std::string digits;
    for (size_t i = 1; i < 37; ++i) {
        const bool dash = i == 9 || i == 14 || i == 19 || i == 24;
        if (dash != (text[i] == '-')) return std::nullopt;
        if (dash) continue;
        if (hexValue(text[i]) < 0) return std::nullopt;
        digits += text[i];
    }
    const auto hex = [&](size_t from, size_t n) {
        uint32_t v = 0;
        for (size_t i = from; i < from + n; ++i) v = v * 16 + static_cast<uint32_t>(hexValue(digits[i]));
        return v;
    };
    Guid g{};
    g.data1 = hex(0, 8);
    g.data2 = static_cast<uint16_t>(hex(8, 4));
    g.data3 = static_cast<uint16_t>(hex(12, 4));
    for (size_t b = 0; b < 8; ++b) g.data4[b] = static_cast<uint8_t>(hex(16 + 2 * b, 2));
    return g;
}

}  // namespace kg::registration
