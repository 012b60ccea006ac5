#ifndef KVT_SUPPLEMENTMODULE_H
#define KVT_SUPPLEMENTMODULE_H

#include "module.h"

/*!
 * A module told about new elements of one element type, which it passes on
 * to a donor module so that the donor can react (add a page for the
 * supplement, for instance).
 *
 * Only the insertion of an element of the supplement's element type reaches
 * the donor; every other operation stops here, and, unlike other modules, a
 * supplement module does not hand operations on to its child modules.
 *
 * Like an acceptor module it has no force reread mode.
 */
class KVTCOMMON_EXPORT SupplementModule : public Module
{
    Q_OBJECT

public:
    SupplementModule(const QString &name, int expectedDepth, const QString &expectedParentId,
                     const QString &description, const QString &elementType, Module *donor,
                     QObject *parent = nullptr);
    ~SupplementModule() override;

    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override;

    Module *donorModule() const { return _donorModule; }
    QString supplementElementType() const { return _supplementElementType; }

protected:
    Module *_donorModule;
    QString _supplementElementType;
};

#endif // KVT_SUPPLEMENTMODULE_H
