#ifndef KVT_SELECTABLEELEMENTSORTFILTERPROXYMODEL_H
#define KVT_SELECTABLEELEMENTSORTFILTERPROXYMODEL_H

#include "elementsortfilterproxymodel.h"

/*!
 * The elements offered for choosing: only nodes whose special flags have
 * bit 2 are shown, and their display text can be taken from another role
 * (selectionDisplayRole()), for instance the title (Qt::UserRole + 4) or the
 * element type (Qt::UserRole + 5).
 */
class KVTCOMMON_EXPORT SelectableElementSortFilterProxyModel : public ElementSortFilterProxyModel
{
    Q_OBJECT

public:
    explicit SelectableElementSortFilterProxyModel(QObject *parent = nullptr);
    SelectableElementSortFilterProxyModel(QSet<int> acceptColumns, QObject *parent = nullptr);
    ~SelectableElementSortFilterProxyModel() override;

    int selectionDisplayRole() const;
    /*! Views are not told about the change; set the role before showing the
     *  model, or reset the views yourself. */
    void setSelectionDisplayRole(int role);

    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;

protected:
    int _selectionDisplayRole;
};

#endif // KVT_SELECTABLEELEMENTSORTFILTERPROXYMODEL_H
