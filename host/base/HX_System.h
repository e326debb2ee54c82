// The calls of the operating system that the C++ library does not have. Every
// such call of the program stands in HX_System.cpp.

#ifndef HOST_BASE_HX_SYSTEM_H
#define HOST_BASE_HX_SYSTEM_H

#include <filesystem>
#include <string>

/// Makes failed writes return errors instead of signals, and opens the standard
/// streams that the process was started without: a file that is opened later
/// never becomes the standard output.
void HX_PrepareProcess();

/// Writes to the standard error output without asking for memory.
void HX_WriteError(const char* text);

/// Keeps memory back for the way out: when the memory ends, that memory is
/// freed and std::bad_alloc is thrown once.
/// \return false without memory to keep: exceptions may then end the program
bool HX_KeepMemoryBack();

/// Whether the memory ended at any time, also where the failure was handled.
bool HX_DidMemoryEnd();

/// Whether a person may read the standard error output.
bool HX_IsErrorOutputTerminal();

/// How to write for a person; nothing special without a terminal.
struct HX_Terminal {
  int width = 0;           ///< columns; 0 for lines of any length
  bool hasColors = false;  ///< never if NO_COLOR is set, or TERM is "dumb"
};
HX_Terminal HX_OutputTerminal();
HX_Terminal HX_ErrorTerminal();

/// The folder of the program file.
std::filesystem::path HX_ProgramFolder();

/// The number of this process, in decimal digits.
std::string HX_ProcessNumber();

/// Keeps other processes that ask for the same lock out of a folder. Leaves no
/// file. Several objects of one process may hold the lock together.
class HX_FolderLock {
 public:
  HX_FolderLock() = default;
  HX_FolderLock(const HX_FolderLock&) = delete;
  HX_FolderLock& operator=(const HX_FolderLock&) = delete;
  ~HX_FolderLock();

  /// File systems without locks count as free.
  /// \return false if another process holds the lock
  bool take(const std::filesystem::path& folder);

 private:
  std::string m_Folder;  // empty for a lock that is not held
};

/// Delays the signals that ask the program to end (SIGHUP, SIGINT, SIGTERM)
/// until the end of the outermost object; blocking calls are interrupted.
class HX_DelayedSignals {
 public:
  HX_DelayedSignals();
  HX_DelayedSignals(const HX_DelayedSignals&) = delete;
  HX_DelayedSignals& operator=(const HX_DelayedSignals&) = delete;
  /// The outermost object raises the last signal that came, if any.
  ~HX_DelayedSignals();

  /// Whether a signal waits.
  static bool isEndRequested();
};

#endif  // HOST_BASE_HX_SYSTEM_H
