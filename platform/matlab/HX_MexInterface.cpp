#include "platform/matlab/HX_MexInterface.h"

#include <algorithm>
#include <cstdarg>
#include <cstdio>
#include <map>
#include <memory>
#include <new>
#include <string>
#include <utility>

#include "platform/HX_NeverDestroyed.h"
#include "platform/matlab/HX_MatlabSession.h"
#include "platform/matlab/HX_MxArrayConverter.h"
#include "platform/matlab/HX_MxContent.h"
#include "platform/strings/KyCXString.h"

namespace {

HX_CommandWindow& commandWindow() {
  static HX_NeverDestroyed<HX_CommandWindow> s_window;
  return s_window.value;
}

std::map<std::string, HX_MatlabFunction>& functions() {
  static HX_NeverDestroyed<std::map<std::string, HX_MatlabFunction>>
      s_functions;
  return s_functions.value;
}

}  // namespace

int mexPrintf(const char* format, ...) {
  std::va_list args;
  va_start(args, format);
  std::va_list again;
  va_copy(again, args);
  int length = std::vsnprintf(nullptr, 0, format, args);
  va_end(args);
  if (length >= 0 && !commandWindow()) {
    std::vprintf(format, again);
  } else if (length >= 0) {
    const auto size = static_cast<std::size_t>(length) + 1;
    const std::unique_ptr<char[]> text(new (std::nothrow) char[size]);
    if (text != nullptr) {
      std::vsnprintf(text.get(), size, format, again);
      commandWindow()(text.get());
    } else {
      length = -1;
    }
  }
  va_end(again);
  return length;
}

void HX_SetCommandWindow(HX_CommandWindow window) {
  commandWindow() = std::move(window);
}

void HX_RegisterMatlabFunction(const char* name, HX_MatlabFunction function) {
  functions()[name] = std::move(function);
}

int MEXCallMATLAB(int outputs, mxArray** output, int inputs, mxArray** input,
                  const char* name) {
  std::fill(output, output + std::max(outputs, 0), nullptr);
  const auto found = functions().find(name);
  if (found == functions().end() || !found->second) return 1;
  return found->second(outputs, output, inputs, input);
}

mxArray* MXCreateInitializedScalarMxArray(double value) {
  return mxCreateScalarDouble(value);
}

void MXDestroyArray(mxArray* array) { mxDestroyArray(array); }

mxArray* MXGetField(mxArray* array, int index, const char* name) {
  return mxGetField(array, index, name);
}

bool MXCopyMXArrayToString(const mxArray* array, KyCXString& text) {
  return HX_MxArrayConverter().mxArrayToString(array, text);
}
