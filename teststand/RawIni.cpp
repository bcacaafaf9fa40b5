#include "teststand/RawIni.h"

#include <QStringDecoder>

#include "files/IniDocument.h"

namespace kg::teststand::rawini {

namespace {

bool isHexDigit(char c) { return (c >= '0' && c <= '9') || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F'); }
int hexValue(char c) { return c <= '9' ? c - '0' : (c | 0x20) - 'a' + 10; }

// Keys as IniFormat looks them up: parts joined by single slashes.
QString normalizedKey(const QString& key)
{
    return key.split(QLatin1Char('/'), Qt::SkipEmptyParts).join(QLatin1Char('/'));
}

}  // namespace

QString fromUtf8Text(QByteArrayView bytes)
{
    QStringDecoder decoder(QStringDecoder::Utf8, QStringDecoder::Flag::Stateless | QStringDecoder::Flag::ConvertInitialBom);
    return decoder.decode(bytes);
}

QByteArray escapeValue(const QString& input)
{
    const QString text = input.startsWith(QLatin1Char('@')) ? QLatin1Char('@') + input : input;
    QByteArray out;
    out.reserve(text.size() + 8);
    bool needsQuotes = false;
    bool escapeNextIfDigit = false;  // after \xNN a hex digit would join the escape
    for (qsizetype i = 0; i < text.size();) {
        const char16_t ch = text.at(i).unicode();
        if (ch >= 0x80) {
            qsizetype j = i + 1;
            while (j < text.size() && text.at(j).unicode() >= 0x80) ++j;
            out += text.mid(i, j - i).toUtf8();
            escapeNextIfDigit = false;
            i = j;
            continue;
        }
        ++i;
        const char c = static_cast<char>(ch);
        if (c == ';' || c == ',' || c == '=') needsQuotes = true;
        if (escapeNextIfDigit && isHexDigit(c)) {
            out += "\\x" + QByteArray::number(ch, 16);
            continue;
        }
        escapeNextIfDigit = false;
        switch (c) {
        case '\0': out += "\\0"; escapeNextIfDigit = true; break;
        case '\a': out += "\\a"; break;
        case '\b': out += "\\b"; break;
        case '\f': out += "\\f"; break;
        case '\n': out += "\\n"; break;
        case '\r': out += "\\r"; break;
        case '\t': out += "\\t"; break;
        case '\v': out += "\\v"; break;
        case '"':
        case '\\': out += '\\'; out += c; break;
        default:
            if (ch <= 0x1F) {
                out += "\\x" + QByteArray::number(ch, 16);
                escapeNextIfDigit = true;
            } else {
                out += c;
            }
        }
    }
    if (needsQuotes || (!out.isEmpty() && (out.front() == ' ' || out.back() == ' '))) out = '"' + out + '"';
    return out;
}

QString unescapeValue(const QByteArray& raw, bool* stored)
{
    static const char escapeCodes[][2] = {{'a', '\a'}, {'b', '\b'}, {'f', '\f'}, {'n', '\n'},
                                          {'r', '\r'}, {'t', '\t'}, {'v', '\v'}, {'"', '"'},
                                          {'?', '?'},  {'\'', '\''}, {'\\', '\\'}};
    const int n = static_cast<int>(raw.size());
    QString out;
    int i = 0;
    bool inQuotes = false;
    bool quoted = false;    // a value with quotes keeps its trailing blanks
    qsizetype keep = 0;     // trailing blanks before this length came from escapes: kept
    auto skipBlanks = [&] {
        while (i < n && (raw[i] == ' ' || raw[i] == '\t')) ++i;
        keep = out.size();
    };
    skipBlanks();
    while (i < n) {
        const char ch = raw[i];
        if (ch == '\\') {
            if (++i >= n) break;
            const char e = raw[i++];
            bool known = false;
            for (const auto& code : escapeCodes)
                if (e == code[0]) {
                    out += QLatin1Char(code[1]);
                    known = true;
                    break;
                }
            if (!known) {
                if (e == 'x' || (e >= '0' && e <= '7')) {
                    const bool hex = e == 'x';
                    if (hex && (i >= n || !isHexDigit(raw[i]))) {
                        keep = out.size();
                        continue;
                    }
                    uint code = hex ? 0 : static_cast<uint>(e - '0');
                    while (i < n && (hex ? isHexDigit(raw[i]) : (raw[i] >= '0' && raw[i] <= '7'))) {
                        code = hex ? code * 16 + static_cast<uint>(hexValue(raw[i])) : code * 8 + static_cast<uint>(raw[i] - '0');
                        code &= 0xFFFF;
                        ++i;
                    }
                    out += QChar(static_cast<char16_t>(code));
                } else if ((e == '\n' || e == '\r') && i < n && (raw[i] == '\n' || raw[i] == '\r') && raw[i] != e) {
                    ++i;  // an escaped line end of two characters
                }
                // any other escaped character is dropped, as IniFormat drops it
            }
            keep = out.size();
        } else if (ch == '"') {
            ++i;
            quoted = true;
            inQuotes = !inQuotes;
            if (!inQuotes) skipBlanks();
        } else {
            int j = i + 1;
            while (j < n && raw[j] != '\\' && raw[j] != '"') ++j;
            out += fromUtf8Text(QByteArrayView(raw.constData() + i, j - i));
            i = j;
        }
    }
    if (!quoted)
        while (out.size() > keep && (out.back() == QLatin1Char(' ') || out.back() == QLatin1Char('\t'))) out.chop(1);

    *stored = true;
    if (out.startsWith(QLatin1Char('@'))) {
        if (out == QLatin1String("@Invalid()")) {
            *stored = false;
            return {};
        }
        if (out.startsWith(QLatin1String("@@"))) return out.mid(1);
        if (out.startsWith(QLatin1String("@ByteArray(")) && out.endsWith(QLatin1Char(')')))
            return out.mid(11, out.size() - 12);
    }
    return out;
}

QByteArray escapeKey(const QString& key)
{
    static const char hexDigits[] = "0123456789ABCDEF";
    QByteArray out;
    out.reserve(key.size());
    for (QChar qc : key) {
        const char16_t ch = qc.unicode();
        if (ch == '/') {
            out += '\\';
        } else if ((ch >= 'a' && ch <= 'z') || (ch >= 'A' && ch <= 'Z') || (ch >= '0' && ch <= '9') || ch == '_' ||
                   ch == '-' || ch == '.') {
            out += static_cast<char>(ch);
        } else if (ch <= 0xFF) {
            out += '%';
            out += hexDigits[ch / 16];
            out += hexDigits[ch % 16];
        } else {
            out += "%U";
            for (int shift = 12; shift >= 0; shift -= 4) out += hexDigits[(ch >> shift) & 0xF];
        }
    }
    return out;
}

QString unescapeKey(const QByteArray& raw)
{
    QString out;
    const int n = static_cast<int>(raw.size());
    int i = 0;
    while (i < n) {
        const char ch = raw[i];
        if (ch == '\\') {
            out += QLatin1Char('/');
            ++i;
            continue;
        }
        if (ch == '%' && i + 1 < n) {
            const int digits = raw[i + 1] == 'U' ? 4 : 2;
            const int first = i + 1 + (digits == 4 ? 1 : 0);
            bool ok = first + digits <= n;
            char16_t code = 0;
            for (int k = first; ok && k < first + digits; ++k) {
                ok = isHexDigit(raw[k]);
                if (ok) code = static_cast<char16_t>(code * 16 + hexValue(raw[k]));
            }
            if (ok) {
                out += QChar(code);
                i = first + digits;
                continue;
            }
        }
        // Plain bytes up to the next escape, read as UTF-8 (a hand-written key may hold any text).
        int j = i + 1;
        while (j < n && raw[j] != '\\' && raw[j] != '%') ++j;
        out += fromUtf8Text(QByteArrayView(raw.constData() + i, j - i));
        i = j;
    }
    return out;
}

Entries entriesOf(QByteArrayView fileText)
{
    const files::IniDocument doc = files::IniDocument::parse(fileText, files::IniDocument::Syntax::IniFormat);
    Entries map;
    for (const files::IniDocument::Section& s : doc.sections()) {
        QString section;  // "" for [General], else "Name/"
        if (&s != &doc.sections().front()) {  // the lines before the first header have none
            if (qstricmp(s.name.constData(), "general") != 0) {
                section = qstricmp(s.name.constData(), "%general") == 0 ? QStringLiteral("General") : unescapeKey(s.name);
                section += QLatin1Char('/');
            }
        }
        for (const files::IniDocument::Line& line : s.lines) {
            if (line.equals == -1) continue;  // neither a section nor a key: skipped, as IniFormat does
            const QString key = normalizedKey(section + unescapeKey(doc.key(line)));
            bool stored = false;
            const QString value = unescapeValue(doc.value(line), &stored);
            if (stored && !key.isEmpty()) map.insert(key, value);
        }
    }
    return map;
}

QByteArray fileTextOf(const Entries& map)
{
    // Sections in order, the keys without a section first (IniFormat's [General]).
    QMap<QString, Entries> sections;
    for (auto it = map.constBegin(); it != map.constEnd(); ++it) {
        const qsizetype slash = it.key().indexOf(QLatin1Char('/'));
        if (slash < 0)
            sections[QString()].insert(it.key(), it.value());
        else
            sections[it.key().left(slash)].insert(it.key().mid(slash + 1), it.value());
    }
    files::IniDocument doc(files::IniDocument::Syntax::IniFormat);
    for (auto it = sections.constBegin(); it != sections.constEnd(); ++it) {
        if (doc.sections().size() > 1) doc.sections().back().appendBlank();
        // A section named like IniFormat's keyless [General] in any case gets its first letter
        // escaped, or it would read back as keys without a section.
        QByteArray name = escapeKey(it.key());
        if (it.key().isNull())
            name = "General";
        else if (it.key() == QLatin1String("General"))
            name = "%General";
        else if (it.key().compare(QLatin1String("general"), Qt::CaseInsensitive) == 0)
            name = QByteArray("%") + QByteArray::number(it.key().at(0).unicode(), 16).toUpper() + name.mid(1);
        files::IniDocument::Section& section = doc.appendSection(name);
        for (auto entry = it.value().constBegin(); entry != it.value().constEnd(); ++entry)
            doc.setValue(section, escapeKey(entry.key()), escapeValue(entry.value()));
    }
    return doc.serialize();
}

}  // namespace kg::teststand::rawini
