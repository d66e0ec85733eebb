#include "model/xml_check.h"

#include <QStringDecoder>
#include <QXmlStreamReader>
#include <QXmlStreamWriter>

bool checkXml(SourceText& text) {
    const std::string_view utf8 = text.view();
    QStringDecoder decoder(QStringConverter::Utf8, QStringConverter::Flag::Stateless);
    const QString decoded = decoder(QByteArrayView(utf8.data(), static_cast<qsizetype>(utf8.size())));
    if (decoder.hasError()) return false;

    QXmlStreamReader reader(decoded);  // from characters, since the declaration may still name the former encoding
    QByteArray expanded;
    QXmlStreamWriter writer(&expanded);
    bool declares = false;
    while (!reader.atEnd()) {
        if (reader.readNext() == QXmlStreamReader::DTD) {
            declares = reader.text().contains(u'[');
        } else if (declares && !reader.hasError()) {
            writer.writeCurrentToken(reader);
        }
    }
    if (reader.hasError()) return false;
    if (declares) text = SourceText(expanded.toStdString());
    return true;
}
