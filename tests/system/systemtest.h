// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_SYSTEMTEST_H
#define KVT_TEST_SYSTEMTEST_H

#include <kvt-common/appexception.h>

#include <QFile>
#include <QTemporaryDir>

inline QByteArray readFile(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

inline bool writeFile(const QString &path, const QByteArray &content)
{
    QFile file(path);
    return file.open(QIODevice::WriteOnly | QIODevice::Truncate) && file.write(content) == content.size();
}

// Runs \a f and returns the text of the AppException it throws, or a null string.
template<typename F>
QString thrown(F f)
{
    try {
        f();
    } catch (const AppException &e) {
        return e.getText();
    }
    return QString();
}

// A temporary folder of small /bin/sh scripts standing in for host programs,
// put first on PATH while the object lives. The previous PATH comes back on
// destruction, also when the test fails half-way.
class FakePrograms
{
public:
    FakePrograms()
        : _savedPath(qgetenv("PATH"))
    {
        qputenv("PATH", QFile::encodeName(_dir.path()) + ':' + _savedPath);
    }
    ~FakePrograms() { qputenv("PATH", _savedPath); }

    QString filePath(const QString &name) const { return _dir.filePath(name); }
    // An executable script `name` running \a body under /bin/sh; returns its path.
    QString add(const QString &name, const QByteArray &body)
    {
        writeFile(filePath(name), "#!/bin/sh\n" + body + '\n');
        QFile::setPermissions(filePath(name), QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ExeOwner);
        return filePath(name);
    }
    // What a fake wrote into the file `name` of the fake folder.
    QByteArray read(const QString &name) const { return readFile(filePath(name)); }

private:
    QTemporaryDir _dir;
    QByteArray _savedPath;
};

#endif
