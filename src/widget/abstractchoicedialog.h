#ifndef KVT_ABSTRACTCHOICEDIALOG_H
#define KVT_ABSTRACTCHOICEDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>
#include <QSet>

class Element;
class FilterTreeNodeSortFilterProxyModel;

namespace Ui {
class AbstractChoiceDialog;
}

/*!
 * The common frame of the choice dialogs: a filter line with a pattern type
 * (wildcard, regular expression or fixed string), a box of display variants
 * and a tree view of the names offered. OK is enabled while a row is
 * selected; accepting the dialog calls makeChoice().
 *
 * A subclass creates its proxy model, stores it in _model and calls
 * afterConstructor() at the end of its constructor.
 *
 * The display-variant box is filled when the dialog is first shown: "All",
 * then, when the root node of the model is an element offering
 * ChangeDisplayOperation, the element's display variants, with its current
 * one selected. Choosing an entry asks the element to change its display to
 * that entry's position. Over any other root the box is disabled.
 */
class KVTCOMMON_EXPORT AbstractChoiceDialog : public QDialog
{
    Q_OBJECT

public:
    explicit AbstractChoiceDialog(QWidget *parent = nullptr);
    ~AbstractChoiceDialog() override;

    // Virtual interface added to QDialog's; the order of declaration is part
    // of the binary interface that plugins are built against.
    virtual void makeChoice() = 0;

    FilterTreeNodeSortFilterProxyModel *model() const { return _model; }
    QSet<int> acceptColumns() const { return _acceptColumns; }
    /*! The columns of the model that the dialog shows (all when empty). */
    void setAcceptColumns(const QSet<int> &columns);
    /*! Shows the subclass's proxy (in _model) in the view; called at the end
     *  of each subclass's constructor. */
    void afterConstructor();

public Q_SLOTS:
    void choice();
    void changeFilter();
    void changeDisplayVariant(int index);
    void selectionChanged();

protected:
    void showEvent(QShowEvent *event) override;

    Ui::AbstractChoiceDialog *_ui;
    FilterTreeNodeSortFilterProxyModel *_model;
    QSet<int> _acceptColumns;

private:
    Element *displayElement() const;
};

#endif // KVT_ABSTRACTCHOICEDIALOG_H
