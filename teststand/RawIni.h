#pragma once
// Settings files in QSettings' INI layout (files/IniDocument.h, Syntax::IniFormat), read so that
// every value is the text stored.
//
// QSettings' own IniFormat reads an unquoted comma as a list separator: a hand-edited "1,5" comes
// back as the list (1, 5), its text cannot be had, and the next write turns it into "1, 5". This
// codec keeps IniFormat's sections, keys and escapes (our files stay readable by IniFormat and
// hand-editable, and our writes quote a comma as IniFormat does), but reads a comma outside quotes
// as text, with the blanks around it. Comments in a hand-edited file do not survive a write, as
// with IniFormat.
#include <QByteArray>
#include <QByteArrayView>
#include <QMap>
#include <QString>

namespace kg::teststand::rawini {

// UTF-8 to text, keeping a U+FEFF at the start: QString::fromUtf8 drops it as a byte order mark,
// but inside a stored key or value it is a character like any other.
QString fromUtf8Text(QByteArrayView bytes);

// Keys "Section/Key/..." to their texts.
using Entries = QMap<QString, QString>;

// One value as IniFormat writes a text: quoted when it holds ; , = or starts or ends with a
// blank; backslash escapes for quotes, backslashes and control characters; a leading @ doubled.
QByteArray escapeValue(const QString& text);
// A value's text back: IniFormat's escapes and quotes undone, commas kept as text.
// `stored` is false for "@Invalid()", IniFormat's mark for a key without a value.
QString unescapeValue(const QByteArray& raw, bool* stored);

// A key or section name as IniFormat writes it: / as \, other characters than letters, digits,
// _ - . as %XX or %UXXXX.
QByteArray escapeKey(const QString& key);
QString unescapeKey(const QByteArray& raw);

// The whole file, keys as "Section/Key/..." (top-level keys without a section come from [General]).
Entries entriesOf(QByteArrayView fileText);
QByteArray fileTextOf(const Entries& entries);

}  // namespace kg::teststand::rawini
