#pragma once

#include <QAbstractListModel>
#include <QListView>
#include <QScopedValueRollback>
#include <QStyledItemDelegate>

class BListView;

/// Tells Qt how many rows there are and what their texts are.
class ListModel final : public QAbstractListModel {
public:
    explicit ListModel(BListView& list) : list_(list) {}

    int rowCount(const QModelIndex& parent) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    /// What typing finds: the next row whose text begins so, or, without any, one with another cell that does.
    QModelIndexList match(const QModelIndex& start, int role, const QVariant& value, int hits,
                          Qt::MatchFlags flags) const override;

    // Changes of the list's rows happen between begin and end.
    void beginInsert(int first, int last) { beginInsertRows({}, first, last); }
    void endInsert() { endInsertRows(); }
    void beginRemove(int first, int last) { beginRemoveRows({}, first, last); }
    void endRemove() { endRemoveRows(); }
    void beginReset() { beginResetModel(); }
    void endReset() { endResetModel(); }

private:
    BListView& list_;
};

/// Has the rows draw themselves.
class ListRows final : public QStyledItemDelegate {
public:
    explicit ListRows(BListView& list) : list_(list) {}

    void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override;
    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override;

private:
    BListView& list_;
};

/// What shows a list view.
class ListWidget final : public QListView {
public:
    explicit ListWidget(BListView& list);
    ~ListWidget() override;

    ListModel& rows() { return rows_; }
    /// As long as the result lives, changes of the selection are not passed on: those of rows take it along.
    [[nodiscard]] auto silence() { return QScopedValueRollback(silent_, true); }

protected:
    void selectionChanged(const QItemSelection& selected, const QItemSelection& deselected) override;
    void keyPressEvent(QKeyEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    bool viewportEvent(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;

private:
    void paintEmptyText();

    BListView& list_;
    ListModel rows_;
    ListRows painter_;
    bool silent_ = true; // until it is set up
};
