#include "fakeprograms.h"

#include <QFile>

FakePrograms::FakePrograms()
{
    _hadPath = qEnvironmentVariableIsSet("PATH");
    _savedPath = qgetenv("PATH");
    qputenv("PATH", QFile::encodeName(_dir.path()) + ':' + _savedPath);
}

FakePrograms::~FakePrograms()
{
    if (_hadPath)
        qputenv("PATH", _savedPath);
    else
        qunsetenv("PATH");
}

QString FakePrograms::add(const QString &name, const QByteArray &body)
{
    const QString path = _dir.filePath(name);
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate))
        return QString();
    file.write("#!/bin/sh\n" + body + '\n');
    file.close();
    file.setPermissions(QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ExeOwner
                        | QFileDevice::ReadGroup | QFileDevice::ExeGroup
                        | QFileDevice::ReadOther | QFileDevice::ExeOther);
    return path;
}

void FakePrograms::useOnlyFakes()
{
    qputenv("PATH", QFile::encodeName(_dir.path()));
}

QByteArray FakePrograms::read(const QString &name) const
{
    QFile file(_dir.filePath(name));
    if (!file.open(QIODevice::ReadOnly))
        return QByteArray();
    return file.readAll();
}
