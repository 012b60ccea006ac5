#ifndef KVT_CONTROLSERVICETASK_H
#define KVT_CONTROLSERVICETASK_H

#include "elementtask.h"

#include <QCoreApplication>
#include <QStringList>

/*!
 * Launches a program detached, as the current user or, when user() is set,
 * as that user through "runuser -u". The task succeeds as soon as the
 * program is launched; its exit code is never known.
 *
 * existPackage() tells whether a Debian package is installed.
 */
class KVTCOMMON_EXPORT ControlServiceTask : public ElementTask
{
    Q_DECLARE_TR_FUNCTIONS(ControlServiceTask)

public:
    explicit ControlServiceTask(Element *element);
    ~ControlServiceTask() override;

    void run() override;
    void afterRun() override;

    const QString &user() const { return _user; }
    void setUser(const QString &user) { _user = user; }
    /*! A string the creator keeps with the task; the library never reads it. */
    const QString &extra() const { return _extra; }
    void setExtra(const QString &extra) { _extra = extra; }
    const QString &program() const { return _program; }
    void setProgram(const QString &program) { _program = program; }
    const QStringList &arguments() const { return _arguments; }
    void setArguments(const QStringList &arguments) { _arguments = arguments; }

    /*! Whether the package \a name is installed: dpkg-query lists it with the
     *  status letters "ii". The name is matched as written ("libstdc++6"),
     *  except that dpkg-query's wildcards "*", "?" and "[...]" keep their
     *  meaning. False when dpkg-query is missing, fails or does not answer
     *  within 30 seconds. */
    static bool existPackage(const QString &name);

protected:
    QString _user;
    QString _extra;
    QString _program;
    QStringList _arguments;
};

#endif // KVT_CONTROLSERVICETASK_H
