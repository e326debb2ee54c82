#include "platform/matlab/HX_MxContent.h"

#include <cstddef>
#include <limits>
#include <map>
#include <string>
#include <variant>
#include <vector>

#include "platform/strings/KyCXString.h"

namespace {

// field name -> its value per element; null where none was set
using Structure = std::map<std::string, std::vector<mxArray*>>;

int s_liveArrays = 0;

}  // namespace

class mxArray {
 public:
  explicit mxArray(std::variant<KyCXString, double, Structure> content)
      : m_Content(std::move(content)) {
    ++s_liveArrays;
  }
  mxArray(const mxArray&) = delete;
  mxArray& operator=(const mxArray&) = delete;
  ~mxArray() {
    --s_liveArrays;
    auto* structure = std::get_if<Structure>(&m_Content);
    if (structure == nullptr) return;
    for (auto& [name, values] : *structure)
      for (mxArray* value : values) delete value;
  }

  const auto& content() const { return m_Content; }

  // The place of a field's value, null if there is none.
  mxArray** place(int index, const char* name) {
    auto* structure = std::get_if<Structure>(&m_Content);
    if (structure == nullptr) return nullptr;
    const auto field = structure->find(name);
    if (field == structure->end()) return nullptr;
    std::vector<mxArray*>& values = field->second;
    const auto element = static_cast<std::size_t>(index);  // negative: huge
    return element < values.size() ? &values[element] : nullptr;
  }

 private:
  std::variant<KyCXString, double, Structure> m_Content;
};

namespace {

// The content of \p array if it is a T, else null.
template <class T>
const T* contentAs(const mxArray* array) {
  return array == nullptr ? nullptr : std::get_if<T>(&array->content());
}

}  // namespace

mxArray* mxCreateString(const char* text) {
  return mxCreateText(KyCXString(text));
}

mxArray* mxCreateText(const KyCXString& text) { return new mxArray(text); }

mxArray* mxCreateScalarDouble(double value) { return new mxArray(value); }

mxArray* mxCreateStructMatrix(int rows, int columns,
                              std::initializer_list<const char*> names) {
  const std::size_t elements =
      rows > 0 && columns > 0
          ? static_cast<std::size_t>(rows) * static_cast<std::size_t>(columns)
          : 0;
  Structure structure;
  for (const char* name : names) structure[name].resize(elements);
  return new mxArray(std::move(structure));
}

void mxDestroyArray(mxArray* array) { delete array; }

bool mxIsChar(const mxArray* array) {
  return contentAs<KyCXString>(array) != nullptr;
}

bool mxIsDouble(const mxArray* array) {
  return contentAs<double>(array) != nullptr;
}

bool mxIsStruct(const mxArray* array) {
  return contentAs<Structure>(array) != nullptr;
}

double mxGetScalar(const mxArray* array) {
  const double* value = contentAs<double>(array);
  return value == nullptr ? std::numeric_limits<double>::quiet_NaN() : *value;
}

const KyCXString* mxGetText(const mxArray* array) {
  return contentAs<KyCXString>(array);
}

mxArray* mxGetField(const mxArray* array, int index, const char* name) {
  if (array == nullptr) return nullptr;
  // The workspace's own interface lets the caller change the value.
  mxArray** place = const_cast<mxArray*>(array)->place(index, name);
  return place == nullptr ? nullptr : *place;
}

void mxSetField(mxArray* array, int index, const char* name, mxArray* value) {
  mxArray** place = array == nullptr ? nullptr : array->place(index, name);
  if (place == nullptr) {
    mxDestroyArray(value);
    return;
  }
  if (*place == value) return;
  mxDestroyArray(*place);
  *place = value;
}

int HX_LiveMxArrays() { return s_liveArrays; }
