#include "teststand/RawIni.h"

#include <QIODevice>
#include <QStringDecoder>

namespace kg::teststand::rawini {

namespace {

bool isBlank(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }
bool isSpecial(char c) { return c == '\n' || c == '\r' || c == '"' || c == ';' || c == '=' || c == '\\'; }
bool isHexDigit(char c) { return (c >= '0' && c <= '9') || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F'); }
int hexValue(char c) { return c <= '9' ? c - '0' : (c | 0x20) - 'a' + 10; }


struct Line {
    int start = 0;
    int length = 0;
    int equals = -1;  // position of the first = outside quotes, or -1
};

// One logical line, as IniFormat reads it: a quoted value or an escaped line end continues the
// line, a ; outside quotes starts a comment, blank lines are skipped.
bool nextLine(const QByteArray& data, int& pos, Line& line)
{
    const int n = static_cast<int>(data.size());
    bool inQuotes = false;
    line.equals = -1;
    int start = pos;
    while (start < n && isBlank(data[start])) ++start;
    int i = start;
    while (i < n) {
        const char ch = data[i++];
        if (!isSpecial(ch)) continue;
        if (ch == '=') {
            if (!inQuotes && line.equals == -1) line.equals = i - 1;
        } else if (ch == '\n' || ch == '\r') {
            if (i == start + 1) {
                ++start;
            } else if (!inQuotes) {
                --i;
                break;
            }
        } else if (ch == '\\') {
            if (i < n) {
                const char escaped = data[i++];
                if (i < n) {
                    const char next = data[i];
                    if ((escaped == '\n' && next == '\r') || (escaped == '\r' && next == '\n')) ++i;
                }
            }
        } else if (ch == '"') {
            inQuotes = !inQuotes;
        } else if (i == start + 1) {  // ';' opening the line: a comment line
            while (i < n && data[i] != '\n' && data[i] != '\r') ++i;
            start = i;
        } else if (!inQuotes) {  // ';' after a value: the rest of the line is a comment
            --i;
            break;
        }
    }
    pos = i;
    line.start = start;
    line.length = i - start;
    return line.length > 0;
}

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

bool readFile(QIODevice& device, Entries& map)
{
    const QByteArray data = device.readAll();
    int pos = data.startsWith("\xEF\xBB\xBF") ? 3 : 0;
    QString section;  // "" for [General], else "Name/"
    Line line;
    while (nextLine(data, pos, line)) {
        if (data[line.start] == '[') {
            const int close = static_cast<int>(data.indexOf(']', line.start));
            const int end = close == -1 || close >= line.start + line.length ? line.start + line.length : close;
            const QByteArray name = data.mid(line.start + 1, end - line.start - 1).trimmed();
            if (qstricmp(name.constData(), "general") == 0) {
                section.clear();
            } else {
                section = qstricmp(name.constData(), "%general") == 0 ? QStringLiteral("General") : unescapeKey(name);
                section += QLatin1Char('/');
            }
            continue;
        }
        if (line.equals == -1) continue;  // neither a section nor a key: skipped, as IniFormat does
        int keyEnd = line.equals;
        while (keyEnd > line.start && (data[keyEnd - 1] == ' ' || data[keyEnd - 1] == '\t')) --keyEnd;
        const QString key = normalizedKey(section + unescapeKey(data.mid(line.start, keyEnd - line.start)));
        bool stored = false;
        const QString value =
            unescapeValue(data.mid(line.equals + 1, line.start + line.length - line.equals - 1), &stored);
        if (stored && !key.isEmpty()) map.insert(key, value);
    }
    return true;
}

bool writeFile(QIODevice& device, const Entries& map)
{
    // Sections in order, the keys without a section first (IniFormat's [General]).
    QMap<QString, QByteArray> sections;
    QByteArray general;
    for (auto it = map.constBegin(); it != map.constEnd(); ++it) {
        const qsizetype slash = it.key().indexOf(QLatin1Char('/'));
        const QByteArray line =
            escapeKey(slash < 0 ? it.key() : it.key().mid(slash + 1)) + '=' + escapeValue(it.value()) + '\n';
        if (slash < 0)
            general += line;
        else
            sections[it.key().left(slash)] += line;
    }
    QByteArray out;
    if (!general.isEmpty()) out += "[General]\n" + general;
    for (auto it = sections.constBegin(); it != sections.constEnd(); ++it) {
        if (!out.isEmpty()) out += '\n';
        // A section named like IniFormat's keyless [General] in any case gets its first letter
        // escaped, or it would read back as keys without a section.
        QByteArray name = escapeKey(it.key());
        if (it.key() == QLatin1String("General"))
            name = "%General";
        else if (it.key().compare(QLatin1String("general"), Qt::CaseInsensitive) == 0)
            name = QByteArray("%") + QByteArray::number(it.key().at(0).unicode(), 16).toUpper() + name.mid(1);
        out += '[' + name + "]\n" + it.value();
    }
    return device.write(out) == out.size();
}

}  // namespace kg::teststand::rawini
