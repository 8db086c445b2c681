// The list box on a QListView over its own items: the view asks only for the rows it shows, so a
// list of 32,767 titles fills at once. Rows stay in the list boxes' own order, not the locale's.
#include <QAbstractListModel>
#include <QItemSelectionModel>
#include <QListView>

#include "list_order/list_order.h"
#include "ui/qt/qt_controls.h"

namespace ui::qt {

// The rows of one list box. The box changes its items only through the calls that tell the view.
class QtListBox::Rows : public QAbstractListModel {
  public:
    using QAbstractListModel::QAbstractListModel;

    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(items.size());
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (role != Qt::DisplayRole || !index.isValid() || index.parent().isValid()) return {};
        const std::string_view text = items.at(static_cast<std::size_t>(index.row()));
        return QString::fromLatin1(text.data(), static_cast<qsizetype>(text.size()));
    }

    void insert(const std::string& text) {
        const int row = static_cast<int>(items.placeFor(text));
        beginInsertRows({}, row, row);
        items.insert(text);
        endInsertRows();
    }
    bool remove(const std::string& text) {
        const std::size_t at = items.find(text);
        if (at == list_order::Items::npos) return false;
        beginRemoveRows({}, static_cast<int>(at), static_cast<int>(at));
        items.remove(text);
        endRemoveRows();
        return true;
    }
    void replace(list_order::Items replacement) {
        beginResetModel();
        items = std::move(replacement);
        endResetModel();
    }

    list_order::Items items;
};

QtListBox::QtListBox(QListView* list) : list_(list), rows_(new Rows(list)) {
    list_->setModel(rows_);
    list_->setSelectionMode(QAbstractItemView::SingleSelection);
    list_->setUniformItemSizes(true);
    list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    clicks_ =
        QObject::connect(list_->selectionModel(), &QItemSelectionModel::selectionChanged, [this] {
            if (!byCode_ && onClick) onClick();
        });
}

// The view may outlive the box (a window's widgets go with the window): it then calls no more.
QtListBox::~QtListBox() {
    QObject::disconnect(clicks_);
}

void QtListBox::addItem(const std::string& text) {
    byCode_ = true;
    rows_->insert(text);
    byCode_ = false;
}

bool QtListBox::removeItem(const std::string& text) {
    byCode_ = true;
    const bool removed = rows_->remove(text);
    byCode_ = false;
    return removed;
}

void QtListBox::setItems(list_order::Items items) {
    byCode_ = true;
    list_->clearSelection();
    rows_->replace(std::move(items));
    byCode_ = false;
}

void QtListBox::clear() {
    setItems({});
}

int QtListBox::count() const {
    return static_cast<int>(rows_->items.size());
}

std::string_view QtListBox::itemText(int index) const {
    return rows_->items.at(static_cast<std::size_t>(index));
}

int QtListBox::selectedIndex() const {
    // Asks the selection, not every row: a long list would otherwise be walked row by row.
    const QModelIndexList rows = list_->selectionModel()->selectedRows();
    return rows.isEmpty() ? -1 : rows.front().row();
}

bool QtListBox::selected(int index) const {
    const QModelIndex row = rows_->index(index);
    return row.isValid() && list_->selectionModel()->isSelected(row);
}

void QtListBox::setSelected(int index, bool selected) {
    const QModelIndex row = rows_->index(index);
    if (!row.isValid()) return;
    byCode_ = true;
    if (selected) list_->setCurrentIndex(row);  // selects it too, and scrolls it into sight
    list_->selectionModel()->select(
        row, selected ? QItemSelectionModel::Select : QItemSelectionModel::Deselect);
    byCode_ = false;
}

void QtListBox::refresh() {
    list_->viewport()->update();
}

}  // namespace ui::qt
