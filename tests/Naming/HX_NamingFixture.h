// Small model, and the expansion of one template.

#ifndef NAMING_HX_NAMINGFIXTURE_H
#define NAMING_HX_NAMINGFIXTURE_H

#include <iterator>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "Naming/HxCNames.h"
#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCStateflowSrcRef.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HX_IvData.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HX_StateflowBlock.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/SC_Chart.h"
#include "platform/model/SC_State.h"
#include "support/HX_TestFixture.h"

/// Reaches the evaluators.
class HxCNamesTestAccess {
 public:
  static int ddObjectName(HxCNames& names, KyCXString& result,
                          unsigned int retained) {
    return names.evaluateDdObjectNameMacro(result, retained, 0x200, "Gain");
  }
  /// Number of the base, and unit; "0?" without an answer.
  static std::string osekBaseTime(double value) {
    auto base = static_cast<HxCNames::tagHxEOsekTimeBase>(0);
    KyCXString unit("?");
    HxCNames().determineOsekBaseTime(value, base, unit);
    return std::to_string(base) + unit.cstring();
  }
};

/// Model "plant v2", subsystem "Ctrl", with blocks
///   car (subsystem r0) / Ctrl (subsystem a3) / Speed Gain
///   car / Ctrl / Mode (a chart block, chart with subsystem id "c")
/// and the chart object "go#" (number 7) with the hierarchy "Top_Run".
class HX_NamingFixture : public HX_TestFixture {
 protected:
  using Id = HxCCIdentifier;

  HX_NamingFixture() {
    HX_MessageHandler::instance().setSink([this](const HX_Message& message) {
      m_Numbers += " " + std::to_string(message.row);
    });
    GLB_SetModelName("plant v2");
    GLB_SetSubsystemName("Ctrl");
    HxCGlobal::setOptions(&options);
    HxCGlobal::setDataTypeServer(&types);
    car.setSubsystem("r", 0);
    ctrl.setSubsystem("a", 3);
    mode.setChartState(&chartState);
    for (SC_Model* object : {static_cast<SC_Model*>(&chartState), &event}) {
      object->setContainingBlock(&mode);
      SC_ModelAccess::setChartState(object, &chartState);
    }
    event.setHierarchy("Top_Run");
  }
  ~HX_NamingFixture() override {
    HxCGlobal::setOptions(nullptr);
    HxCGlobal::setDataTypeServer(nullptr);
    HxCGlobal::setIvData(nullptr);
    HX_DdTree::instance().clear();
  }

  /// Message 7 with the error code of the engine.
  static constexpr const char* kAssertion =
      "7/3 Internal error. Error code: HxCNames[0-9]+\\..*";

  /// An identifier with the template \p form for \p srcRef.
  static Id identifier(const std::string& form, const HxCSrcRef* srcRef) {
    Id id(form.c_str());
    id.setSourceRef(srcRef);
    return id;
  }
  Id identifier(const std::string& form) {
    return identifier(form, gain.getSrcRef());
  }

  /// Expansion of \p form for \p srcRef, by default for the block gain.
  std::string expand(const std::string& form, const HxCSrcRef* srcRef,
                     unsigned int retained = 0, unsigned int provisional = 0) {
    return expandId(identifier(form, srcRef), retained, provisional);
  }
  std::string expand(const std::string& form) {
    return expandId(identifier(form));
  }
  std::string expandId(Id id, unsigned int retained = 0,
                       unsigned int provisional = 0) {
    complete = names.createNameFromForm(id, type, retained, provisional, quiet);
    noted = notedOf(id);
    return shown(id);
  }

  /// The name, or "formal:actual" for different names, and the numbers of the
  /// messages since the last call: "x_$Q 1203".
  std::string shown(const Id& id) {
    const std::string formal = id.getCookedName(Id::eFormalName).cstring();
    const std::string actual = id.getCookedName(Id::eActualName).cstring();
    return formal + (actual == formal ? "" : ":" + actual) +
           std::exchange(m_Numbers, "");
  }

  /// Notes of both names: R for a name that may change, L, E and N for the use
  /// of a macro. "RL:" is a formal name with two notes and an actual name
  /// without notes.
  static std::string notedOf(const Id& id) {
    const auto notes = [&id](Id::HxENameTypeTag name) {
      return std::string(id.getIdentifierChangeable(name) ? "R" : "") +
             (id.getDollarLUsed(name) ? "L" : "") +
             (id.getDollarEUsed(name) ? "E" : "") +
             (id.getDollarNUsed(name) ? "N" : "");
    };
    return notes(Id::eFormalName) + ":" + notes(Id::eActualName);
  }

  /// Parts of \p text between blanks.
  static std::vector<std::string> words(const std::string& text) {
    std::istringstream stream(text);
    return {std::istream_iterator<std::string>(stream), {}};
  }

  HX_OptionsExt options;
  HX_DataTypeServer types;
  HX_Block car{"car"};
  HX_Block ctrl{"Ctrl", &car};
  HX_Block gain{"Speed Gain", &ctrl};
  HX_StateflowBlock mode{"Mode", &ctrl};
  SC_Chart chart{"c"};
  SC_State chartState{1, 4, "Mode chart", &chart};
  SC_Model event{2, 7, "go#"};
  HxCNames names;
  // Input and output of the expansions.
  HX_DataType* type = nullptr;
  bool quiet = false;
  bool complete = false;
  std::string noted;

 private:
  std::string m_Numbers;
};

#endif  // NAMING_HX_NAMINGFIXTURE_H
