#include "files/IniDocument.h"

#include "core/Dispatch.h"

namespace kg::files {

namespace {

bool isSpace(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\v' || c == '\f' || c == '\r'; }

QByteArray trimmed(QByteArrayView s)
{
    qsizetype b = 0, e = s.size();
    while (b < e && isSpace(s[b])) ++b;
    while (e > b && isSpace(s[e - 1])) --e;
    return s.sliced(b, e - b).toByteArray();
}

// --- Syntax::Lines -------------------------------------------------------------------------------

std::optional<QByteArray> headerName(QByteArrayView line)
{
    const QByteArray t = trimmed(line);
    if (t.size() < 2 || t.front() != '[' || t.back() != ']') return std::nullopt;
    return trimmed(QByteArrayView(t).sliced(1, t.size() - 2));
}

void parseLines(QByteArrayView all, std::vector<IniDocument::Section>& sections)
{
    qsizetype start = 0;
    while (start < all.size()) {
        qsizetype end = all.indexOf('\n', start);
        if (end < 0) end = all.size();
        QByteArrayView line = all.sliced(start, end - start);
        if (line.endsWith('\r')) line.chop(1);
        start = end + 1;
        const std::optional<QByteArray> name = headerName(line);
        if (name) sections.push_back({*name, {}});
        sections.back().lines.push_back({line.toByteArray(), name ? -1 : line.indexOf('=')});
    }
}

// --- Syntax::IniFormat ---------------------------------------------------------------------------

bool isBlank(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }
bool isSpecial(char c) { return c == '\n' || c == '\r' || c == '"' || c == ';' || c == '=' || c == '\\'; }

struct Span {
    qsizetype start = 0;
    qsizetype length = 0;
    qsizetype equals = -1;  // position of the first = outside quotes, or -1
};

// One logical line, as IniFormat reads it: a quoted value or an escaped line end continues the
// line, a ; outside quotes starts a comment, blank lines are skipped.
bool nextLine(QByteArrayView data, qsizetype& pos, Span& line)
{
    const qsizetype n = data.size();
    bool inQuotes = false;
    line.equals = -1;
    qsizetype start = pos;
    while (start < n && isBlank(data[start])) ++start;
    qsizetype i = start;
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

void parseIniFormat(QByteArrayView data, std::vector<IniDocument::Section>& sections)
{
    qsizetype pos = data.startsWith("\xEF\xBB\xBF") ? 3 : 0;
    Span span;
    while (nextLine(data, pos, span)) {
        const QByteArrayView text = data.sliced(span.start, span.length);
        if (text.front() == '[') {
            const qsizetype close = text.indexOf(']');
            const QByteArrayView name = text.sliced(1, (close == -1 ? text.size() : close) - 1);
            sections.push_back({name.trimmed().toByteArray(), {}});
        }
        sections.back().lines.push_back(
            {text.toByteArray(), text.front() == '[' || span.equals == -1 ? -1 : span.equals - span.start});
    }
}

}  // namespace

IniDocument::Section& IniDocument::Section::append(const QByteArray& key, const QByteArray& value)
{
    lines.push_back({key + '=' + value, key.size()});
    return *this;
}

IniDocument::Section& IniDocument::Section::appendBlank()
{
    lines.push_back({});
    return *this;
}

IniDocument IniDocument::parse(QByteArrayView bytes, Syntax syntax)
{
    IniDocument doc(syntax);
    if (syntax == Syntax::Lines)
        parseLines(bytes, doc.sections_);
    else
        parseIniFormat(bytes, doc.sections_);
    return doc;
}

QByteArray IniDocument::serialize() const
{
    QByteArray out;
    for (const Section& s : sections_)
        for (const Line& line : s.lines) out += line.text + '\n';
    return out;
}

bool IniDocument::sameName(QByteArrayView a, QByteArrayView b) const
{
    if (syntax_ == Syntax::IniFormat) return a == b;
    // ASCII letters only, as member names are matched: other bytes are parts of UTF-8 characters.
    return equalsNoCase(std::string_view(a.data(), size_t(a.size())), std::string_view(b.data(), size_t(b.size())));
}

IniDocument::Section* IniDocument::find(QByteArrayView name)
{
    for (size_t i = 1; i < sections_.size(); ++i)
        if (sameName(sections_[i].name, name)) return &sections_[i];
    return nullptr;
}

QByteArray IniDocument::key(const Line& line) const
{
    if (syntax_ == Syntax::Lines) return trimmed(QByteArrayView(line.text).first(line.equals));
    qsizetype end = line.equals;
    while (end > 0 && (line.text[end - 1] == ' ' || line.text[end - 1] == '\t')) --end;
    return line.text.first(end);
}

QByteArray IniDocument::value(const Line& line) const
{
    const QByteArrayView raw = QByteArrayView(line.text).sliced(line.equals + 1);
    return syntax_ == Syntax::Lines ? trimmed(raw) : raw.toByteArray();
}

std::optional<QByteArray> IniDocument::value(const Section& section, QByteArrayView key) const
{
    for (const Line& line : section.lines) {
        if (line.equals >= 0 && sameName(this->key(line), key)) return value(line);
    }
    return std::nullopt;
}

bool IniDocument::isComment(const Line& line) const
{
    const QByteArray t = trimmed(line.text);
    return !t.isEmpty() && (t.front() == ';' || (syntax_ == Syntax::Lines && t.front() == '#'));
}

IniDocument::Section& IniDocument::appendSection(const QByteArray& name)
{
    sections_.push_back({name, {{'[' + name + ']', -1}}});
    return sections_.back();
}

void IniDocument::setValue(Section& section, const QByteArray& key, const QByteArray& value)
{
    for (Line& line : section.lines)
        if (line.equals >= 0 && sameName(this->key(line), key)) {
            line = {key + '=' + value, key.size()};
            return;
        }
    section.append(key, value);
}

void IniDocument::removeSection(size_t index)
{
    for (const Line& line : sections_[index].lines)
        if (isComment(line)) sections_[index - 1].lines.push_back(line);
    sections_.erase(sections_.begin() + static_cast<std::ptrdiff_t>(index));
}

}  // namespace kg::files
