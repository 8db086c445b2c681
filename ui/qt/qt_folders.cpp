#include "ui/qt/qt_folders.h"

#include <QComboBox>
#include <QDir>
#include <QFileInfo>
#include <QFileSystemModel>
#include <QStorageInfo>
#include <QTreeView>
#include <algorithm>

#include "ui/qt/qt_controls.h"

namespace ui::qt {

std::string volumeOf(const std::string& path) {
    const QStorageInfo info(toQt(path));
    if (!info.isValid()) return "/";
    return fromQt(info.rootPath());
}

QtDriveList::QtDriveList(QComboBox* combo) : combo_(combo) {
    reload();
    QObject::connect(combo_, &QComboBox::currentIndexChanged, [this](int) {
        if (onChange) onChange();
    });
}

void QtDriveList::reload() {
    QStringList roots;
    for (const QStorageInfo& volume : QStorageInfo::mountedVolumes()) {
        if (volume.isValid() && volume.isReady() && !roots.contains(volume.rootPath())) {
            roots.append(volume.rootPath());
        }
    }
    if (!roots.contains(QStringLiteral("/"))) roots.append(QStringLiteral("/"));
    std::sort(roots.begin(), roots.end());
    const QSignalBlocker quiet(combo_);
    combo_->clear();
    combo_->addItems(roots);
}

std::vector<std::string> QtDriveList::drives() const {
    std::vector<std::string> out;
    for (int i = 0; i < combo_->count(); ++i) out.push_back(fromQt(combo_->itemText(i)));
    return out;
}

std::string QtDriveList::drive() const {
    return fromQt(combo_->currentText());
}

bool QtDriveList::setDrive(const std::string& drive) {
    const int index = combo_->findText(toQt(drive), Qt::MatchExactly | Qt::MatchCaseSensitive);
    if (index < 0) return false;
    combo_->setCurrentIndex(index);
    return true;
}

QtDirList::QtDirList(QTreeView* view) : view_(view), model_(new QFileSystemModel(view)) {
    model_->setFilter(QDir::AllDirs | QDir::NoDotAndDotDot);
    model_->setRootPath(QStringLiteral("/"));
    view_->setModel(model_);
    for (int column = 1; column < model_->columnCount(); ++column) view_->hideColumn(column);
    view_->setHeaderHidden(true);
    QObject::connect(view_->selectionModel(), &QItemSelectionModel::currentChanged,
                     [this](const QModelIndex& current) {
                         if (current.isValid()) path_ = fromQt(model_->filePath(current));
                     });
}

bool QtDirList::setPath(const std::string& path) {
    const QFileInfo info(toQt(path));
    if (path.empty() || !info.isDir() || !info.isReadable() || !QDir(toQt(path)).exists()) {
        return false;
    }
    QString clean = QDir::cleanPath(info.absoluteFilePath());
    const std::string volume = volumeOf(fromQt(clean));
    view_->setRootIndex(model_->index(toQt(volume)));
    path_ = fromQt(clean);
    const QModelIndex index = model_->index(clean);
    view_->setCurrentIndex(index);
    view_->scrollTo(index);
    view_->expand(index);
    path_ = fromQt(clean);
    return true;
}

}  // namespace ui::qt
