// A folder that goes with the test, and its files as bytes.
#pragma once

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include <string>

class Folder {
public:
    // Of a file in it, or of the folder with its separator.
    std::string path(const std::string& name = "") const { return folder_.path().toStdString() + "/" + name; }
    QString qPath(const char* name = "") const { return QString::fromStdString(path(name)); }

    void write(const std::string& name, const QByteArray& bytes) const {
        QFile file(QString::fromStdString(path(name)));
        if (!file.open(QIODevice::WriteOnly) || file.write(bytes) != bytes.size())
            qFatal("the folder of a test is full");
    }
    std::string read(const std::string& name) const {
        QFile file(QString::fromStdString(path(name)));
        return file.open(QIODevice::ReadOnly) ? file.readAll().toStdString() : "not there";
    }
    // Nobody may write it any more.
    void protect(const std::string& name) const {
        QFile::setPermissions(QString::fromStdString(path(name)), QFile::ReadOwner);
    }
    qsizetype files() const { return QDir(folder_.path()).entryList(QDir::Files | QDir::Hidden).size(); }

private:
    QTemporaryDir folder_;
};
