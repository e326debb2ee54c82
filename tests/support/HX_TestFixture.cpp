#include "support/HX_TestFixture.h"

#include <regex>

#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_HeapCount.h"

void PrintTo(const KyCXString& text, std::ostream* stream) {
  *stream << '"' << text.cstring() << '"';
}

HX_TestFixture::HX_TestFixture() { reset(); }

HX_TestFixture::~HX_TestFixture() { reset(); }

std::vector<std::string> HX_TestFixture::messages() {
  std::vector<std::string> result;
  for (const HX_Message& m : HX_MessageHandler::instance().messages()) {
    result.push_back(std::to_string(m.row) + "/" + std::to_string(m.severity) +
                     " " + m.text);
    if (m.srcRef != nullptr) result.back() += " [" + m.source + "]";
  }
  return result;
}

void HX_TestFixture::clearMessages() { HX_MessageHandler::instance().clear(); }

std::vector<std::string>& HX_TestFixture::recordDebugReports() {
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  handler.setShowInternalInfo(true);
  handler.setDebugReport([this](const char*, int, const char* expression) {
    m_DebugReports.emplace_back(expression);
    return 0;
  });
  return m_DebugReports;
}

void HX_TestFixture::reset() {
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  handler.clear();
  handler.setSink({});
  handler.setDebugReport({});
  handler.setShowInternalInfo(false);
  pHXMemory = nullptr;
  HX_ClockSource::install(nullptr);
}

void* HX_CountingController::allocMemBlock(unsigned long size) {
  const int number = m_Asked++;
  if (number >= m_FirstFailure && number <= m_LastFailure) return nullptr;
  ++m_Live;
  return HxCMemController::allocMemBlock(size);
}

void HX_CountingController::freeMemBlock(void* block) {
  if (block != nullptr) --m_Live;
  HxCMemController::freeMemBlock(block);
}

namespace {

// Memory(number, allAfter) gives out blocks while alive.
template <class Memory>
void withoutEachBlock(const char* why, bool (*job)()) {
  for (const bool allAfter : {false, true}) {
    for (int missing = 0;; ++missing) {
      bool done = false;
      int live = 0;
      int asked = 0;
      {
        Memory memory(missing, allAfter);
        done = job();
        live = memory.liveBlocks();
        asked = memory.allocated();
      }
      SCOPED_TRACE(testing::Message()
                   << why << " without block " << missing
                   << (allAfter ? " and all later blocks" : ""));
      ASSERT_EQ(live, 0) << "leaks";
      if (asked <= missing) {
        EXPECT_TRUE(done);
        EXPECT_GT(missing, 0) << "asks for no block";
        break;
      }
      if (missing == 0) {
        EXPECT_FALSE(done);
      }
    }
  }
}

struct FailingController : HX_CountingController {
  FailingController(int number, bool allAfter) { failAt(number, allAfter); }
};

}  // namespace

bool HX_FitsPattern(const std::string& text, const std::string& pattern) {
  return std::regex_match(text, std::regex(pattern));
}

void HX_WithoutEachBlock(const char* why, bool (*job)()) {
  withoutEachBlock<FailingController>(why, job);
}

void HX_WithoutEachHeapBlock(const char* why, bool (*job)()) {
  withoutEachBlock<HX_FailingHeap>(why, job);
}
