// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_EDITWIDGET_H
#define KVT_TEST_EDITWIDGET_H

#include <kvt-common/element.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/vieweditelementwidget.h>

#include <QLineEdit>
#include <QStringList>

// A content editor as a plugin writes one: a line edit for the "text" value
// of the element's record. Empty text is not valid. Records the hooks the
// framework calls, as "read(<element id>)", "update", "import(<text>)",
// "beforeCreation", and every state it reports with contentChanged().
class EditWidget : public ViewEditElementWidget
{
    Q_OBJECT

public:
    EditWidget(Module &module, RightsPredicate rights, const QString &type = QStringLiteral("user"),
               QWidget *parent = nullptr)
        : ViewEditElementWidget(module, rights, parent), edit(new QLineEdit(this))
    {
        _elementType = type;
        connect(edit, SIGNAL(textEdited(QString)), this, SLOT(changeContent()));
        connect(this, SIGNAL(contentChanged(int)), this, SLOT(record(int)));
    }

    QString toolTipText() const override { return QStringLiteral("editor"); }

    void beforeCreation() override { hooks.append(QStringLiteral("beforeCreation")); }

    ElementData *exportElementData() const override
    {
        auto *data = new ElementData;
        data->setName(edit->text());
        data->insert(QStringLiteral("text"), edit->text());
        return data;
    }

    void afterSuccessfulRead(Element *element, ElementData *data) override
    {
        hooks.append(QStringLiteral("read(%1)").arg(element ? element->id() : QStringLiteral("null")));
        if (data && element == this->element())
            edit->setText(data->value(QStringLiteral("text")).toString());
        ViewEditElementWidget::afterSuccessfulRead(element, data);
    }

    void afterSuccessfulImport(ElementData *data) override
    {
        const QString text = data ? data->value(QStringLiteral("text")).toString() : QString();
        hooks.append(QStringLiteral("import(%1)").arg(text));
        edit->setText(text);
        ViewEditElementWidget::afterSuccessfulImport(data);
    }

    void afterSuccessfulUpdate() override { hooks.append(QStringLiteral("update")); }

    bool isContentValid() const override { return !edit->text().isEmpty(); }

    void userTypes(const QString &text)
    {
        edit->setText(text);
        Q_EMIT edit->textEdited(text);
    }

    QLineEdit *edit;
    QStringList hooks;
    QList<int> reported;

private Q_SLOTS:
    void record(int state) { reported.append(state); }
};

#endif
