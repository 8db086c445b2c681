#pragma once

#include <string>

#include "ui/controls.h"

class QComboBox;
class QFileSystemModel;
class QTreeView;

class QString;

// Folders cross to the window logic as the file system's own bytes, never as Latin-1 text: any
// folder the system can name is shown decoded and handed back byte for byte.
namespace ui::qt {

// The text of file-system bytes, and the bytes of a text, as the toolkit encodes file names.
QString fromFileSystem(const std::string& bytes);
std::string toFileSystem(const QString& name);

// The mounted volumes, as a pick-only combo box. onChange fires for the user and for code.
class QtDriveList : public DriveList {
  public:
    explicit QtDriveList(QComboBox* combo);
    std::vector<std::string> drives() const override;
    std::string drive() const override;
    bool setDrive(const std::string& drive) override;
    // Lists the volumes again.
    void reload();

  private:
    QComboBox* combo_;
};

// The folders of one volume as a tree; the path is the folder the user picked.
class QtDirList : public DirList {
  public:
    explicit QtDirList(QTreeView* view);
    std::string path() const override { return path_; }
    bool setPath(const std::string& path) override;
    QFileSystemModel* model() const { return model_; }

  private:
    QTreeView* view_;
    QFileSystemModel* model_;
    std::string path_;
};

// The mounted volume holding a path, as its root path ("/" when unknown).
std::string volumeOf(const std::string& path);

}  // namespace ui::qt
