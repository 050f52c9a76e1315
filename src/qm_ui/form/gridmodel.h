// A bound table as Qt's item model.
#pragma once

#include "qm_ui/form/formfield.h"
#include "qm_ui/form/gridbinding.h"

#include <QAbstractTableModel>

class CGridModel : public QAbstractTableModel {
public:
    /// changed: after each cell that was taken.
    CGridModel(T_GRID_BINDING binding, ChangedFn changed, QObject* parent);

    const T_GRID_BINDING& Binding() const { return m_binding; }
    /// The model's rows may have changed.
    void Refresh();
    /// A cell's text as a person types it. 0: refused.
    int Take(int row, int column, const QString& typed);

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;
    bool setData(const QModelIndex& index, const QVariant& value, int role) override;

private:
    const T_GRID_COLUMN& Column(int column) const;
    QString Text(const QModelIndex& index) const;
    QString ShownText(const QModelIndex& index) const;

    T_GRID_BINDING m_binding;
    ChangedFn m_changed;
    int m_rows = 0;
};
