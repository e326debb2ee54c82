#include "host/base/HX_System.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <iterator>
#include <map>
#include <new>

namespace fs = std::filesystem;

namespace {

constexpr int kEndSignals[] = {SIGHUP, SIGINT, SIGTERM};
constexpr int kEndSignalCount = static_cast<int>(std::size(kEndSignals));

struct sigaction s_Before[kEndSignalCount];
volatile std::sig_atomic_t s_Waiting = 0;  // last delayed signal
int s_SignalUsers = 0;                     // objects of HX_DelayedSignals
void* s_MemoryKept = nullptr;
bool s_DidMemoryEnd = false;

struct HeldFolder {
  int file;
  int count;  // of HX_FolderLock
};
std::map<std::string, HeldFolder> s_HeldFolders;  // by canonical path

HX_Terminal terminalOf(int descriptor) {
  HX_Terminal terminal;
  if (isatty(descriptor) == 0) return terminal;
  winsize size = {};
  const bool isKnown = ioctl(descriptor, TIOCGWINSZ, &size) == 0;
  constexpr int kNarrowest = 40;  // below that, wrapping helps nobody
  if (isKnown && size.ws_col >= kNarrowest) terminal.width = size.ws_col;
  const char* noColor = std::getenv("NO_COLOR");
  const char* kind = std::getenv("TERM");
  terminal.hasColors = (noColor == nullptr || *noColor == '\0') &&
                       kind != nullptr && std::strcmp(kind, "dumb") != 0;
  return terminal;
}

}  // namespace

HX_Terminal HX_OutputTerminal() { return terminalOf(STDOUT_FILENO); }

HX_Terminal HX_ErrorTerminal() { return terminalOf(STDERR_FILENO); }

void HX_WriteError(const char* text) {
  std::size_t length = std::strlen(text);
  while (length > 0) {
    const auto written = write(STDERR_FILENO, text, length);
    if (written <= 0) return;
    text += written;
    length -= static_cast<std::size_t>(written);
  }
}

bool HX_KeepMemoryBack() {
  constexpr std::size_t kEnough = 1 << 20;
  if (s_MemoryKept == nullptr) s_MemoryKept = std::malloc(kEnough);
  std::set_new_handler([] {
    s_DidMemoryEnd = true;
    std::free(s_MemoryKept);
    s_MemoryKept = nullptr;
    throw std::bad_alloc();
  });
  return s_MemoryKept != nullptr;
}

bool HX_DidMemoryEnd() { return s_DidMemoryEnd; }

void HX_PrepareProcess() {
  std::signal(SIGPIPE, SIG_IGN);
  std::signal(SIGXFSZ, SIG_IGN);
  int file = 0;
  while (file >= 0 && file <= STDERR_FILENO) file = open("/dev/null", O_RDONLY);
  close(file);
}

bool HX_IsErrorOutputTerminal() { return isatty(STDERR_FILENO) != 0; }

fs::path HX_ProgramFolder() {
  return fs::read_symlink("/proc/self/exe").parent_path();
}

std::string HX_ProcessNumber() { return std::to_string(getpid()); }

HX_FolderLock::~HX_FolderLock() {
  if (m_Folder.empty()) return;
  const auto held = s_HeldFolders.find(m_Folder);
  if (--held->second.count > 0) return;
  close(held->second.file);
  s_HeldFolders.erase(held);
}

bool HX_FolderLock::take(const fs::path& folder) {
  std::error_code error;
  const std::string name = fs::canonical(folder, error).string();
  if (error) return true;  // opening a file will tell
  const auto known = s_HeldFolders.find(name);
  if (known != s_HeldFolders.end()) {
    ++known->second.count;
    m_Folder = name;
    return true;
  }
  const int file = open(name.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (file < 0) return true;
  if (flock(file, LOCK_EX | LOCK_NB) != 0) {
    const bool isHeld = errno == EWOULDBLOCK;
    close(file);
    return !isHeld;
  }
  s_HeldFolders[name] = {file, 1};
  m_Folder = name;
  return true;
}

HX_DelayedSignals::HX_DelayedSignals() {
  if (s_SignalUsers++ > 0) return;
  struct sigaction note = {};
  note.sa_handler = [](int signal) { s_Waiting = signal; };
  for (int i = 0; i < kEndSignalCount; ++i) {
    sigaction(kEndSignals[i], nullptr, &s_Before[i]);
    if (s_Before[i].sa_handler == SIG_DFL)
      sigaction(kEndSignals[i], &note, nullptr);
  }
}

HX_DelayedSignals::~HX_DelayedSignals() {
  if (--s_SignalUsers > 0) return;
  for (int i = 0; i < kEndSignalCount; ++i)
    sigaction(kEndSignals[i], &s_Before[i], nullptr);
  if (s_Waiting != 0) std::raise(s_Waiting);
}

bool HX_DelayedSignals::isEndRequested() { return s_Waiting != 0; }
