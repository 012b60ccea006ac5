// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_RECORDINGMODULE_H
#define KVT_TEST_RECORDINGMODULE_H

#include <kvt-common/element.h>
#include <kvt-common/module.h>

#include <QStringList>

#include <functional>

/*!
 * A module that records every operation performed through it as a readable
 * string, "<operation>(<context>)": "Inserted(user_alice)",
 * "ReadContent(group_staff)", "Create(widget)", "0x100(x)" for a code
 * without a name. With flags other than 0, " flags=<n>" is appended.
 *
 * A test can react to an operation (to simulate what a plugin's task would
 * do) through onOperation; the base module's forwarding to child modules is
 * kept.
 */
class RecordingModule : public Module
{
    Q_OBJECT

public:
    explicit RecordingModule(const QString &name, QObject *parent = nullptr, bool paranoid = false);

    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override;

    static QString operationName(OperationType type);

    // Test access to the module's bookkeeping that a plugin fills.
    QList<TreeNode *> &elementNodesRef() { return _elementNodes; }
    ElementData *moduleDataRef() { return _moduleData; }
    void setElementActions(const QString &type, const QList<QAction *> &actions)
    {
        _elementActionsMap.insert(type, actions);
    }

    QStringList log;
    QList<ElementData *> dataLog; // the record given with each operation
    std::function<void(ContextOperation *, OperationType, ElementData *)> onOperation;
};

/*!
 * A concrete element of any kind: the kinds leave the tool tip to plugins.
 * Lets a test choose the element type, group type and expectations that a
 * plugin's element sets in its constructor.
 */
template <class Kind>
class TestElement : public Kind
{
public:
    TestElement(Module &module, ContextOperation::RightsPredicate rights,
                const QString &type = QStringLiteral("user"), const QString &title = QString())
        : Kind(module, rights)
    {
        this->_elementType = type;
        if (!title.isEmpty())
            this->setTitle(title);
    }

    QString toolTipText() const override { return QStringLiteral("tip:") + this->title(); }

    void setExpected(int depth, const QString &parentId)
    {
        this->_expectedDepth = depth;
        this->_expectedParentId = parentId;
    }
    void setGroupType(const QString &type) { this->_groupElementType = type; }
};

bool rightsYes(const Module &);
bool rightsNo(const Module &);

#endif
