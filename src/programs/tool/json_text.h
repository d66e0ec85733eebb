// From the records' text to JSON.
#pragma once

#include "util/message_host.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QString>

inline QString jsonText(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

inline QJsonArray jsonMessages(const MessageHost& host) {
    QJsonArray messages;
    for (const MessageHost::Message& message : host.messages()) {
        messages.append(QJsonObject{{"Title", jsonText(message.title)}, {"Text", jsonText(message.text)}});
    }
    return messages;
}

inline void printJson(const QJsonObject& document) {
    const QByteArray text = QJsonDocument(document).toJson(QJsonDocument::Indented);
    std::fwrite(text.constData(), 1, static_cast<std::size_t>(text.size()), stdout);
}
