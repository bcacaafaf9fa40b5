#include "capi/Registration.h"

#include <QDir>
#include <QFileInfo>

#include "core/Error.h"
#include "files/IniDocument.h"
#include "files/WholeFile.h"

namespace kg::registration {

namespace {

using files::IniDocument;

// Our section in place of an older one of the same name (duplicates dropped), else at the end.
void replaceOrAppend(IniDocument& doc, IniDocument::Section ours)
{
    ours.appendBlank();  // a blank line keeps the sections apart
    bool placed = false;
    auto& sections = doc.sections();
    for (size_t i = 1; i < sections.size();) {
        if (!equalsNoCase(sections[i].name.toStdString(), ours.name.toStdString())) {
            ++i;
        } else if (!placed) {
            for (const IniDocument::Line& line : sections[i].lines)
                if (doc.isComment(line)) ours.lines.push_back(line);
            sections[i] = ours;
            placed = true;
            ++i;
        } else {
            doc.removeSection(i);
        }
    }
    if (placed) return;
    const IniDocument::Section& last = sections.back();
    if (!last.lines.empty() && !last.lines.back().text.trimmed().isEmpty()) sections.back().appendBlank();
    sections.push_back(std::move(ours));
}

Error accessError(const std::string& file, const std::string& what)
{
    return Error(errc::PathFileAccess, "Path/File access error: registration file \"" + file + "\" " + what);
}

IniDocument read(const std::string& file)
{
    QByteArray text;
    if (const auto reason = files::readWholeFile(QString::fromStdString(file), text))
        throw accessError(file, "cannot be read: " + reason->toStdString());
    return IniDocument::parse(text, IniDocument::Syntax::Lines);
}

// Synced to disk before it replaces the old file: readers see the old file or the new one, never a
// part, also after a power cut.
void write(const std::string& file, const IniDocument& doc)
{
    const QString path = QString::fromStdString(file);
    const QString folder = QFileInfo(path).absolutePath();
    if (!QDir().mkpath(folder))
        throw accessError(file, "cannot be written: its folder \"" + folder.toStdString() + "\" cannot be created");
    static const char* const steps[] = {"open", "write", "sync", "rename"};  // by WriteFailure::Step
    if (const auto failed = files::writeWholeFile(path, doc.serialize(), files::Sync::ToDisk))
        throw accessError(file, std::string("cannot be written (") + steps[failed->step] +
                                    "): " + failed->reason.toStdString());
}

IniDocument::Section section(const std::string& name, std::initializer_list<std::pair<std::string, std::string>> entries)
{
    IniDocument::Section s{QByteArray::fromStdString(name), {{QByteArray::fromStdString("[" + name + "]"), -1}}};
    for (const auto& [key, value] : entries) s.append(QByteArray::fromStdString(key), QByteArray::fromStdString(value));
    return s;
}

std::optional<std::string> valueOf(const IniDocument& doc, const IniDocument::Section& s, const char* key)
{
    const std::optional<QByteArray> value = doc.value(s, key);
    if (!value) return std::nullopt;
    return value->toStdString();
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
    IniDocument doc = read(file);
    replaceOrAppend(doc, section(classSectionName(kClsidTavixGraph),
                                 {{"ProgID", kProgId},
                                  {"InprocServer", libraryPath},
                                  {"Interface", std::string(kInterfaceName) + " " + guidText(kIidTavixGraph)}}));
    replaceOrAppend(doc, section(progIdSectionName(kProgId), {{"CLSID", guidText(kClsidTavixGraph)}}));
    write(file, doc);
}

void unregisterServer(const std::string& file)
{
    IniDocument doc = read(file);
    auto& sections = doc.sections();
    const size_t before = sections.size();
    const std::string ourClass = classSectionName(kClsidTavixGraph);
    const std::string ourProgId = progIdSectionName(kProgId);
    for (size_t i = 1; i < sections.size();) {
        const IniDocument::Section& s = sections[i];
        bool ours = equalsNoCase(s.name.toStdString(), ourClass);
        // The programmatic name may meanwhile belong to another class: then it is not ours to remove.
        if (!ours && equalsNoCase(s.name.toStdString(), ourProgId)) {
            const std::optional<std::string> clsid = valueOf(doc, s, "CLSID");
            const std::optional<Guid> g = clsid ? parseGuid(*clsid) : std::nullopt;
            ours = g && *g == kClsidTavixGraph;
        }
        if (ours)
            doc.removeSection(i);
        else
            ++i;
    }
    if (sections.size() != before) write(file, doc);
}

std::optional<ClassRegistration> findProgId(const std::string& progId, const std::string& file)
{
    IniDocument doc = read(file);
    const IniDocument::Section* prog = doc.find(QByteArray::fromStdString(progIdSectionName(progId)));
    if (!prog) return std::nullopt;
    const std::optional<std::string> clsidText = valueOf(doc, *prog, "CLSID");
    if (!clsidText) return std::nullopt;
    const std::optional<Guid> clsid = parseGuid(*clsidText);
    if (!clsid)
        throw Error::typeMismatch("registration file \"" + file + "\": [" + prog->name.toStdString() + "] CLSID=" + *clsidText +
                                  " is not a class id");
    const IniDocument::Section* cls = doc.find(QByteArray::fromStdString(classSectionName(*clsid)));
    if (!cls) return std::nullopt;
    const std::optional<std::string> library = valueOf(doc, *cls, "InprocServer");
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
