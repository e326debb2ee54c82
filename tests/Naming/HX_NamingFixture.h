// A model small enough to know by heart, and the expansion of one template.

#ifndef NAMING_HX_NAMINGFIXTURE_H
#define NAMING_HX_NAMINGFIXTURE_H

#include <iterator>
#include <sstream>
#include <string>
#include <vector>

#include "Naming/HxCNames.h"
#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCStateflowSrcRef.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/datatypes/HX_DataTypeServer.h"
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
  static int dollarELength(const char* text, int start) {
    return HxCNames::findDollarELength(text, start);
  }
  static void osekBaseTime(double value, HxCNames::tagHxEOsekTimeBase& base,
                           KyCXString& unit) {
    HxCNames::determineOsekBaseTime(value, base, unit);
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

  /// An identifier with the template \p form for \p srcRef.
  static Id identifier(const char* form, const HxCSrcRef* srcRef) {
    Id id(form);
    id.setSourceRef(srcRef);
    return id;
  }

  /// The formal name that \p form gives for \p srcRef.
  std::string expand(const char* form, const HxCSrcRef* srcRef,
                     HX_DataType* type = nullptr, unsigned int retained = 0,
                     unsigned int provisional = 0) {
    Id id = identifier(form, srcRef);
    return expand(id, type, retained, provisional);
  }
  std::string expand(Id& id, HX_DataType* type = nullptr,
                     unsigned int retained = 0, unsigned int provisional = 0) {
    complete = names.createNameFromForm(id, type, retained, provisional, false);
    changeable = id.getIdentifierChangeable(Id::eFormalName);
    return formal(id);
  }

  static std::string formal(const Id& id) {
    return id.getCookedName(Id::eFormalName).cstring();
  }
  static std::string actual(const Id& id) {
    return id.getCookedName(Id::eActualName).cstring();
  }

  /// What stands between the blanks of \p text.
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
  bool complete = false;
  bool changeable = false;
};

#endif  // NAMING_HX_NAMINGFIXTURE_H
