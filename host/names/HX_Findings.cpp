#include "host/names/HX_Findings.h"

#include "host/base/HX_Text.h"
#include "host/model/HX_SourcePaths.h"
#include "platform/messages/HX_MessageHandler.h"

HX_Finding HX_Remark(HX_MessageNumber number,
                     std::initializer_list<std::string_view> arguments,
                     const std::string& source) {
  return {number, HX_FindMessage(number)->severity,
          HX_MessageText(number, arguments), source};
}

HX_MessageCollector* HX_MessageCollector::s_Current = nullptr;

HX_MessageCollector::HX_MessageCollector(std::vector<HX_Finding>& findings)
    : m_Findings(findings), m_Outer(s_Current) {
  direct(this);
}

HX_MessageCollector::~HX_MessageCollector() {
  HX_MessageHandler::instance().clear();
  direct(m_Outer);
}

void HX_MessageCollector::direct(HX_MessageCollector* collector) {
  s_Current = collector;
  if (collector == nullptr) return HX_MessageHandler::instance().setSink({});
  HX_MessageHandler::instance().setSink([collector](const HX_Message& message) {
    collector->m_Findings.push_back({message.id, message.severity,
                                     HX_Latin1ToUtf8(message.text),
                                     HX_PathOf(message.srcRef)});
  });
}
