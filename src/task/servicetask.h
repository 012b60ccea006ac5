#ifndef KVT_SERVICETASK_H
#define KVT_SERVICETASK_H

#include "elementtask.h"

#include <QCoreApplication>
#include <QStringList>

/*!
 * Base of the tasks that query or control a system service by running its
 * control program and reading the exit code.
 *
 * The creator sets program() and arguments() (typically the service's
 * name); the subclass fixes the command word ("status", "start", ...), which
 * goes before the arguments, or after them with setCommandFirst(false).
 *
 * With a ServiceLightElementData record the task is a status query: the
 * exit code only selects the state (0 running, anything else stopped) and
 * the task succeeds. Without one, any exit code other than 0 fails the task
 * with the program's standard error. A program that does not start, does not
 * finish or crashes fails the task too. There is no time limit on the
 * program once it runs.
 */
class KVTCOMMON_EXPORT ServiceTask : public ElementTask
{
    Q_DECLARE_TR_FUNCTIONS(ServiceTask)

public:
    ServiceTask(Element *element, ElementData *data = nullptr);
    ~ServiceTask() override;

    void run() override;

    bool commandFirst() const { return _commandFirst; }
    void setCommandFirst(bool first) { _commandFirst = first; }
    const QString &program() const { return _program; }
    void setProgram(const QString &program) { _program = program; }
    const QString &command() const { return _command; }
    const QStringList &arguments() const { return _arguments; }
    void setArguments(const QStringList &arguments) { _arguments = arguments; }

    /*! The arguments the program is started with: the command word and the
     *  arguments in the order commandFirst() says. */
    QStringList commandLine() const;

protected:
    bool _commandFirst;
    QString _program;
    QString _command;
    QStringList _arguments;
};

#endif // KVT_SERVICETASK_H
