#include "util/settings_file.h"

#include <QIODevice>

namespace {

constexpr QChar kEscape('\\');
constexpr QChar kSectionEnd('/');     // behind the section, in the keys of QSettings
constexpr qsizetype kHexDigits = 4;   // of an escaped character: \u000a
const QString kNameMarks("=[];#");    // what a name cannot hold as it is
const QString kNoSection("General");  // of lines before the first heading

bool isControl(QChar letter) {
    return letter.unicode() < 0x20 || letter.unicode() == 0x7F || letter.isSurrogate();
}

QString hexEscape(QChar letter) {
    return QString("\\u%1").arg(letter.unicode(), kHexDigits, 16, QChar('0'));
}

// A blank at either end would be lost with those around the line's parts.
QString escaped(const QString& text, const QString& marks) {
    QString written;
    for (qsizetype at = 0; at < text.size(); ++at) {
        const QChar letter = text[at];
        const bool edge = at == 0 || at == text.size() - 1;
        if (letter == kEscape) {
            written += "\\\\";
        } else if (isControl(letter) || marks.contains(letter) || (edge && letter.isSpace())) {
            written += hexEscape(letter);
        } else {
            written += letter;
        }
    }
    return written;
}

// What is no escape stands for itself: a path typed by hand may hold backslashes.
QString unescaped(QStringView text) {
    QString read;
    for (qsizetype at = 0; at < text.size(); ++at) {
        const QStringView rest = text.sliced(at);
        bool hex = false;
        if (rest.startsWith(u"\\\\")) {
            read += kEscape;
            ++at;
            continue;
        }
        const ushort code = rest.startsWith(u"\\u") ? rest.mid(2, kHexDigits).toUShort(&hex, 16) : ushort{0};
        if (hex && rest.size() >= 2 + kHexDigits) {
            read += QChar(code);
            at += 1 + kHexDigits;
        } else {
            read += text[at];
        }
    }
    return read;
}

bool isComment(QStringView line) {
    return line.startsWith(u';') || line.startsWith(u'#');
}

QStringView nameIn(QStringView key) {
    return key.sliced(key.indexOf(kSectionEnd) + 1);
}

}  // namespace

bool readSettingsFile(QIODevice& device, QSettings::SettingsMap& entries) {
    QString text = QString::fromUtf8(device.readAll());
    if (text.startsWith(QChar::ByteOrderMark)) text.remove(0, 1);
    QString section = kNoSection;
    for (const QStringView wholeLine : QStringView(text).split(u'\n')) {
        const QStringView line = wholeLine.trimmed();
        const qsizetype equals = line.indexOf(u'=');
        if (line.startsWith(u'[') && line.endsWith(u']')) {
            section = line.sliced(1, line.size() - 2).toString().replace(kSectionEnd, '.');
            if (section.isEmpty()) section = kNoSection;
        } else if (isComment(line) || (equals <= 0 && !line.isEmpty())) {
            entries.insert(section + kSectionEnd + line.toString(), QVariant());
        } else if (!line.isEmpty()) {
            entries.insert(section + kSectionEnd + unescaped(line.first(equals).trimmed()),
                           unescaped(line.sliced(equals + 1).trimmed()));
        }
    }
    return true;
}

bool writeSettingsFile(QIODevice& device, const QSettings::SettingsMap& entries) {
    QString text;
    QString section;
    for (auto entry = entries.begin(); entry != entries.end(); ++entry) {
        const QString own = entry.key().section(kSectionEnd, 0, 0);
        if (own != section) {
            if (!text.isEmpty()) text += '\n';
            text += '[' + own + "]\n";
            section = own;
        }
        const QString name = nameIn(entry.key()).toString();
        text +=
            entry.value().isValid() ? escaped(name, kNameMarks) + '=' + escaped(entry.value().toString(), {}) : name;
        text += '\n';
    }
    const QByteArray bytes = text.toUtf8();
    return device.write(bytes) == bytes.size();
}

bool isIllegibleEntry(const QString& key, const QVariant& value) {
    return !value.isValid() && !isComment(nameIn(key));
}
