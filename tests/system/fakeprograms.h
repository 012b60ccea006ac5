#ifndef KVT_TEST_FAKEPROGRAMS_H
#define KVT_TEST_FAKEPROGRAMS_H

#include <QByteArray>
#include <QString>
#include <QTemporaryDir>

/*!
 * A temporary folder of small /bin/sh scripts standing in for host programs,
 * put first on PATH while the object lives. The previous PATH comes back on
 * destruction, also when the test fails half-way.
 */
class FakePrograms
{
public:
    FakePrograms();
    ~FakePrograms();
    FakePrograms(const FakePrograms &) = delete;
    FakePrograms &operator=(const FakePrograms &) = delete;

    bool isValid() const { return _dir.isValid(); }
    QString path() const { return _dir.path(); }
    QString filePath(const QString &name) const { return _dir.filePath(name); }

    // Writes an executable script `name` whose body is \a body (after the
    // "#!/bin/sh" line) and returns its full path.
    QString add(const QString &name, const QByteArray &body);

    // Replaces PATH by the fake folder alone, so that every other program is
    // missing; restored with the object as well.
    void useOnlyFakes();

    // Reads a file written by a fake (its arguments, a pid).
    QByteArray read(const QString &name) const;

private:
    QTemporaryDir _dir;
    QByteArray _savedPath;
    bool _hadPath = false;
};

#endif
