#pragma once

#include <string>
#include <string_view>

// One running copy per catalogue folder: an advisory lock on a file in the folder, held for the
// life of the process. The system drops it when the process ends, however it ends, so a copy
// that was killed never keeps the folder locked.
namespace catalogue {

inline constexpr std::string_view kLockName = "pemla.lock";

class FolderLock {
  public:
    enum class State {
        Held,      // this process holds the folder
        Taken,     // another process holds it
        Unlocked,  // no lock could be made here (a file system without locks, a folder that
                   // takes no new file); the program runs without one
    };

    // Tries to lock `folder` at once, without waiting.
    explicit FolderLock(const std::string& folder);
    ~FolderLock();
    FolderLock(const FolderLock&) = delete;
    FolderLock& operator=(const FolderLock&) = delete;

    State state() const { return state_; }

  private:
    int fd_ = -1;
    State state_ = State::Unlocked;
};

}  // namespace catalogue
