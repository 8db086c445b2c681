// The list box on a QListWidget: its rows kept in the list boxes' own order, not the locale's.
#include <QItemSelectionModel>
#include <QListWidget>
#include <algorithm>

#include "list_order/list_order.h"
#include "ui/qt/qt_controls.h"

namespace ui::qt {

QtListBox::QtListBox(QListWidget* list) : list_(list) {
    list_->setSelectionMode(QAbstractItemView::SingleSelection);
    list_->setSortingEnabled(false);  // the order is ours, not the locale's
    list_->setUniformItemSizes(true);
    QObject::connect(list_, &QListWidget::itemSelectionChanged, [this] {
        if (!byCode_ && onClick) onClick();
    });
}

void QtListBox::addItem(const std::string& text) {
    const auto at = std::upper_bound(items_.begin(), items_.end(), text, list_order::itemLess);
    const int index = static_cast<int>(at - items_.begin());
    items_.insert(at, text);
    byCode_ = true;
    list_->insertItem(index, toQt(text));
    byCode_ = false;
}

bool QtListBox::removeItem(const std::string& text) {
    const auto at = std::lower_bound(items_.begin(), items_.end(), text, list_order::itemLess);
    if (at == items_.end() || *at != text) return false;
    const int index = static_cast<int>(at - items_.begin());
    items_.erase(at);
    byCode_ = true;
    delete list_->takeItem(index);
    byCode_ = false;
    return true;
}

void QtListBox::setItems(std::vector<std::string> items) {
    list_order::sortItems(items);
    byCode_ = true;
    list_->clearSelection();
    if (!applyFewChanges(items)) {
        QStringList texts;
        texts.reserve(static_cast<qsizetype>(items.size()));
        for (const auto& item : items) texts.append(toQt(item));
        list_->setUpdatesEnabled(false);
        list_->clear();
        list_->addItems(texts);
        list_->setUpdatesEnabled(true);
    }
    items_ = std::move(items);
    byCode_ = false;
}

bool QtListBox::applyFewChanges(const std::vector<std::string>& items) {
    // A list shown again after one entry was added, changed or deleted differs in a few rows;
    // changing just those keeps a long list box from being rebuilt item by item.
    constexpr std::size_t kMaxChanges = 16;
    if (items_.empty()) return false;
    const std::size_t gap =
        items.size() > items_.size() ? items.size() - items_.size() : items_.size() - items.size();
    if (gap > kMaxChanges) return false;
    struct Change {
        int row;
        const std::string* insert;  // nothing: remove the row
    };
    std::vector<Change> changes;
    std::size_t i = 0;
    std::size_t j = 0;
    int row = 0;
    while (i < items_.size() || j < items.size()) {
        if (i < items_.size() && j < items.size() && items_[i] == items[j]) {
            ++i, ++j, ++row;
        } else if (j >= items.size() ||
                   (i < items_.size() && list_order::itemLess(items_[i], items[j]))) {
            changes.push_back({row, nullptr});
            ++i;
        } else {
            changes.push_back({row, &items[j]});
            ++j, ++row;
        }
        if (changes.size() > kMaxChanges) return false;
    }
    for (const Change& change : changes) {
        if (change.insert != nullptr) {
            list_->insertItem(change.row, toQt(*change.insert));
        } else {
            delete list_->takeItem(change.row);
        }
    }
    return true;
}

void QtListBox::clear() {
    items_.clear();
    byCode_ = true;
    list_->clear();
    byCode_ = false;
}

const std::string& QtListBox::itemText(int index) const {
    return items_.at(static_cast<std::size_t>(index));
}

int QtListBox::selectedIndex() const {
    // Asks the selection, not every row: a long list would otherwise be walked item by item.
    const QModelIndexList rows = list_->selectionModel()->selectedRows();
    return rows.isEmpty() ? -1 : rows.front().row();
}

bool QtListBox::selected(int index) const {
    const QListWidgetItem* item = list_->item(index);
    return item != nullptr && item->isSelected();
}

void QtListBox::setSelected(int index, bool selected) {
    QListWidgetItem* item = list_->item(index);
    if (item == nullptr) return;
    byCode_ = true;
    if (selected) {
        list_->setCurrentItem(item);
    }
    item->setSelected(selected);
    byCode_ = false;
}

void QtListBox::refresh() {
    list_->viewport()->update();
}
}  // namespace ui::qt
