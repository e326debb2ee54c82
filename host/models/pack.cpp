// Packs files into a zip archive; equal files give equal bytes on any machine.
//
//   hx_pack ARCHIVE FOLDER FILE...     FILE counts from FOLDER
#include <zip.h>

#include <cstdio>
#include <string>

namespace {

// The first day that the archive's own clock knows.
constexpr zip_uint16_t kDosDate = 1 << 5 | 1;

bool add(zip_t* archive, const std::string& folder, const char* file) {
  zip_source_t* source =
      zip_source_file(archive, (folder + "/" + file).c_str(), 0, -1);
  const zip_int64_t index = zip_file_add(archive, file, source, 0);
  if (index < 0) return false;
  return zip_file_set_dostime(archive, static_cast<zip_uint64_t>(index), 0,
                              kDosDate, 0) == 0;
}

}  // namespace

int main(int argc, char** argv) {
  if (argc < 4) return 2;
  int error = 0;
  zip_t* archive = zip_open(argv[1], ZIP_CREATE | ZIP_TRUNCATE, &error);
  if (archive == nullptr) return 1;
  bool isPacked = true;
  for (int i = 3; i < argc; ++i)
    isPacked = isPacked && add(archive, argv[2], argv[i]);
  if (isPacked && zip_close(archive) == 0) return 0;
  std::fprintf(stderr, "%s: %s\n", argv[1], zip_strerror(archive));
  return 1;
}
