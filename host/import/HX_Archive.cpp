#include "host/import/HX_Archive.h"

#include <zip.h>

#include <fstream>

#include "host/import/HX_PartText.h"

namespace fs = std::filesystem;

namespace {

struct FileCloser {
  void operator()(zip_file_t* file) const { zip_fclose(file); }
};

std::string textOfZipError(int code) {
  zip_error_t error;
  zip_error_init_with_code(&error, code);
  std::string text = zip_error_strerror(&error);
  zip_error_fini(&error);
  return text;
}

// The first line of a file in text form tells the kind.
bool isTextForm(const fs::path& file) {
  if (file.extension() == ".mdl") return true;
  std::ifstream stream(file, std::ios::binary);
  std::string line;
  std::getline(stream, line);
  for (const char* head : {"Model {", "Library {", "Subsystem {"}) {
    if (line.rfind(head, 0) == 0) return true;
  }
  return false;
}

bool leadsOutside(std::string_view name) {
  if (name.empty() || name.front() == '/') return true;
  if (name.find('\\') != std::string_view::npos) return true;
  if (name.size() > 1 && name[1] == ':') return true;
  for (const fs::path& step : fs::path(name)) {
    if (step == "..") return true;
  }
  return false;
}

}  // namespace

void HX_Archive::Closer::operator()(zip* archive) const {
  zip_discard(archive);
}

HX_Archive::HX_Archive(const fs::path& file, const HX_ImportLimits& limits)
    : m_File(file.string()) {
  std::error_code ignored;
  if (!fs::is_regular_file(file, ignored))
    throw HX_ImportError(m_File + ": expected a file that can be read");
  if (isTextForm(file))
    throw HX_ImportError(
        m_File +
        ": the text form of models (.mdl) is not read; open the model "
        "where it was made and save it as .slx");
  int code = 0;
  m_Zip.reset(zip_open(m_File.c_str(), ZIP_RDONLY, &code));
  if (!m_Zip)
    throw HX_ImportError(m_File +
                         ": expected a zip archive: " + textOfZipError(code));
  const zip_int64_t count = zip_get_num_entries(m_Zip.get(), 0);
  if (static_cast<std::uint64_t>(count) > limits.parts)
    throw HX_ImportError(m_File + ": " + std::to_string(count) +
                         " parts, expected at most " +
                         std::to_string(limits.parts));
  for (zip_int64_t i = 0; i < count; ++i)
    enter(static_cast<std::uint64_t>(i), limits);
}

void HX_Archive::enter(std::uint64_t index, const HX_ImportLimits& limits) {
  zip_stat_t stat;
  if (zip_stat_index(m_Zip.get(), index, 0, &stat) != 0)
    throw HX_ImportError(m_File + ": part " + std::to_string(index + 1) + ": " +
                         zip_strerror(m_Zip.get()));
  const std::string name = stat.name;
  if (!name.empty() && name.back() == '/') return;  // a folder
  if (leadsOutside(name)) fail(name, "the name leads outside the archive");
  if (stat.encryption_method != ZIP_EM_NONE)
    fail(name, "the part is encrypted");
  if (stat.size > limits.partSize)
    fail(name, std::to_string(stat.size) + " bytes, expected at most " +
                   std::to_string(limits.partSize));
  if (stat.size > limits.ratioFrom && stat.size / limits.ratio > stat.comp_size)
    fail(name, "packed more than " + std::to_string(limits.ratio) +
                   " to 1, which no model is");
  m_TotalSize += stat.size;
  if (m_TotalSize > limits.totalSize)
    throw HX_ImportError(m_File + ": unpacks to more than " +
                         std::to_string(limits.totalSize) + " bytes");
  if (!m_Entries.try_emplace(name, Entry{index, stat.size}).second)
    fail(name, "the archive holds two parts of this name");
}

bool HX_Archive::has(std::string_view part) const {
  return m_Entries.find(part) != m_Entries.end();
}

std::string HX_Archive::read(std::string_view part) const {
  const auto found = m_Entries.find(part);
  if (found == m_Entries.end()) fail(part, "the part is missing");
  const std::unique_ptr<zip_file_t, FileCloser> file(
      zip_fopen_index(m_Zip.get(), found->second.index, 0));
  if (!file) fail(part, zip_strerror(m_Zip.get()));

  // One byte more than announced: a longer part is seen without reading on,
  // and the checksum is compared at the end of the data.
  std::string text(found->second.size + 1, '\0');
  std::size_t size = 0;
  for (;;) {
    const zip_int64_t got =
        zip_fread(file.get(), text.data() + size, text.size() - size);
    if (got < 0) fail(part, zip_file_strerror(file.get()));
    size += static_cast<std::size_t>(got);
    if (got == 0 || size == text.size()) break;
  }
  if (size != found->second.size)
    fail(part, "the size differs from the table of contents");
  text.pop_back();
  return text;
}

void HX_Archive::fail(std::string_view part, const std::string& reason) const {
  throw HX_ImportError(m_File + ": " + HX_OneLine(part) + ": " + reason);
}
