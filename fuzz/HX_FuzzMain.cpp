// Entry points of libFuzzer; one program per check.
#include <cstddef>
#include <cstdint>

#include "fuzz/HX_Fuzz.h"
#include "platform/messages/HX_MessageHandler.h"

extern "C" int LLVMFuzzerInitialize(int*, char***) {
  HX_MessageHandler::instance().setSink({});  // not to standard error
  return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data,
                                      std::size_t size) {
  HX_Bytes bytes(std::string(data, data + size));
  HX_FUZZ_CHECK(bytes);
  return 0;
}
