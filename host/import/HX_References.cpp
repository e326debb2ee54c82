#include "host/import/HX_References.h"

namespace fs = std::filesystem;

HX_References::HX_References(std::vector<fs::path> folders,
                             const HX_ImportLimits& limits)
    : m_Folders(std::move(folders)), m_Limits(limits) {}

const HX_ModelFile* HX_References::find(const std::string& name) {
  const bool hasEnding = name.size() > 4 && name.ends_with(".slx");
  const std::string fileName = hasEnding ? name : name + ".slx";
  const auto known = m_Files.find(fileName);
  if (known != m_Files.end()) return known->second.get();
  const fs::path path = pathOf(fileName);
  std::unique_ptr<HX_ModelFile> file;
  if (!path.empty()) file = std::make_unique<HX_ModelFile>(path, m_Limits);
  return m_Files.emplace(fileName, std::move(file)).first->second.get();
}

fs::path HX_References::pathOf(const std::string& fileName) const {
  if (fileName.find_first_of("/\\") != std::string::npos) return {};
  for (const fs::path& folder : m_Folders) {
    std::error_code ignored;
    if (fs::is_regular_file(folder / fileName, ignored))
      return folder / fileName;
  }
  return {};
}
