#include "ui/qt/qt_folders.h"

#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QFileSystemModel>
#include <QStorageInfo>
#include <QTreeView>
#include <algorithm>

namespace ui::qt {

QString fromFileSystem(const std::string& bytes) {
    return QFile::decodeName(QByteArray(bytes.data(), static_cast<qsizetype>(bytes.size())));
}

std::string toFileSystem(const QString& name) {
    const QByteArray bytes = QFile::encodeName(name);
    return std::string(bytes.constData(), static_cast<std::size_t>(bytes.size()));
}

std::string volumeOf(const std::string& path) {
    const QStorageInfo info(fromFileSystem(path));
    if (!info.isValid()) return "/";
    return toFileSystem(info.rootPath());
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
    for (int i = 0; i < combo_->count(); ++i) out.push_back(toFileSystem(combo_->itemText(i)));
    return out;
}

std::string QtDriveList::drive() const {
    return toFileSystem(combo_->currentText());
}

bool QtDriveList::setDrive(const std::string& drive) {
    const int index =
        combo_->findText(fromFileSystem(drive), Qt::MatchExactly | Qt::MatchCaseSensitive);
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
                         if (current.isValid()) path_ = toFileSystem(model_->filePath(current));
                     });
}

bool QtDirList::setPath(const std::string& path) {
    // Bytes that are no UTF-8 cannot be named through the toolkit, so they are not taken at all
    // rather than turned into some other folder.
    if (toFileSystem(fromFileSystem(path)) != path) return false;
    const QFileInfo info(fromFileSystem(path));
    if (path.empty() || !info.isDir() || !info.isReadable() ||
        !QDir(fromFileSystem(path)).exists()) {
        return false;
    }
    QString clean = QDir::cleanPath(info.absoluteFilePath());
    const std::string volume = volumeOf(toFileSystem(clean));
    view_->setRootIndex(model_->index(fromFileSystem(volume)));
    path_ = toFileSystem(clean);
    const QModelIndex index = model_->index(clean);
    view_->setCurrentIndex(index);
    view_->scrollTo(index);
    view_->expand(index);
    path_ = toFileSystem(clean);
    return true;
}

}  // namespace ui::qt
