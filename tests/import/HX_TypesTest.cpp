// Types as a model writes types, and as the document has the types.
#include "host/import/HX_TypeTable.h"

#include <sstream>

#include "host/import/HX_Dictionary.h"
#include "host/import/HX_Notes.h"
#include "host/import/HX_Rules.h"
#include "import/HX_ImportTest.h"

using testing::ElementsAre;

namespace {

class TypesTest : public HX_ImportTest {
 protected:
  TypesTest() { m_Dictionary.read(pack("d.sldd", partsOf("climate_types"))); }

  HX_TypeUse use(const char* text, int elements = 1) {
    return m_Types.resolve({text, "int32", elements, text});
  }

  // "id name kind" and the members of a type, in a line each.
  std::string shown(const std::string& id) const {
    std::ostringstream out;
    for (const HX_ImportedType& type : m_Types.types()) {
      if (type.id != id) continue;
      out << type.name << ' ' << type.kind << ' ' << type.of;
      if (type.length > 0) out << " * " << type.length;
      for (const auto& [name, of] : type.fields)
        out << "\n  " << name << ": " << of;
      for (const auto& [name, value] : type.values)
        out << "\n  " << name << " = " << value;
    }
    return out.str();
  }

  HX_Notes m_Notes;
  HX_Rules m_Rules;
  HX_Dictionary m_Dictionary{m_Request.limits, m_Notes};
  const HX_TypeTable::Reserved m_Reserved = {"int", "register", "Float32"};
  HX_TypeTable m_Types{m_Rules, m_Dictionary, m_Reserved, m_Notes};
};

TEST_F(TypesTest, EachFormOfTypeIsUnderstood) {
  const struct {
    const char* text;
    const char* id;
    double lsb;
    double zero;
  } rows[] = {
      {"double", "double", 1, 0},
      {"single", "single", 1, 0},
      {"uint8", "uint8", 1, 0},
      {"int64", "int64", 1, 0},
      {"boolean", "boolean", 1, 0},
      {"logical", "boolean", 1, 0},
      {"uint16_t", "uint16", 1, 0},
      {"fixdt(1,16)", "int16", 1, 0},
      {"fixdt(0,1)", "uint8", 1, 0},
      {"fixdt(1, 8, 3)", "int8", 0.125, 0},
      {"fixdt(1,9,-2)", "int16", 4, 0},
      {"fixdt(0,17,2^-4,0)", "uint32", 0.0625, 0},
      {"fixdt(true,33,0.5,-40)", "int64", 0.5, -40},
      {"fixdt(0,64,1.25,2,7)", "uint64", 5, 7},
      {"fixdt('single')", "single", 1, 0},
      {"Enum: ClimateMode", "Enum: ClimateMode", 1, 0},
      {"Enum:ClimateMode", "Enum: ClimateMode", 1, 0},
      {"ClimateMode", "Enum: ClimateMode", 1, 0},
      {"Bus: sensor_t", "Bus: sensor_t", 1, 0},
      {"temp_t", "uint16", 1, 0},
      {"", "int32", 1, 0},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.text);
    const HX_TypeUse found = use(row.text);
    EXPECT_EQ(row.id, found.id);
    EXPECT_EQ(row.lsb, found.lsb);
    EXPECT_EQ(row.zero, found.zero);
  }
  EXPECT_EQ("Float32_2 base ", shown("single"));  // "Float32" is reserved
  EXPECT_EQ("Bool derived uint8", shown("boolean"));
}

TEST_F(TypesTest, UnknownTypesTakeTheRulesTypeWithANoteOnce) {
  for (const char* text :
       {"Enum: Gone", "Bus: Gone", "half", "fixdt(1,65)", "fixdt(1,0)",
        "fixdt(1,16,2^-8", "fixdt(1,16,-1,0)", "fixdt(1,16,0,0)", "fixdt(1,w)",
        "fixdt()", "Inherit: auto", "Inherit: auto"})
    EXPECT_EQ("int32", use(text).id) << text;
  EXPECT_EQ("double", m_Types.resolve({"half", "gone", 1, ""}).id);
  const auto lines = m_Notes.lines();
  ASSERT_EQ(11U, lines.size());
  EXPECT_EQ(
      "warning: the type 'Enum: Gone' is unknown: the type of the naming "
      "rule is taken (Enum: Gone)",
      lines[0]);
  EXPECT_EQ(
      "note: 'Inherit: auto' takes the type of the naming rule (Inherit: "
      "auto and 1 more)",
      lines[10]);
}

TEST_F(TypesTest, DictionaryGivesMembers) {
  m_Types.addDictionary();
  EXPECT_EQ(
      "sensor_t struct \n  value: uint16[4]\n"
      "  register_2: Enum: ClimateMode\n  self: double",
      shown("Bus: sensor_t"));
  EXPECT_EQ("UInt16_4 array uint16 * 4", shown("uint16[4]"));
  EXPECT_EQ(
      "ClimateMode enum \n  ClimateMode_off = 0\n"
      "  ClimateMode_int = -3\n  ClimateMode_next = -2",
      shown("Enum: ClimateMode"));
  EXPECT_EQ("Plain enum \n  int_2 = 1", shown("Enum: Plain"));
  EXPECT_EQ("Huge derived int32", shown("Enum: Huge"));
}

TEST_F(TypesTest, ArraysStandOnTheirElements) {
  EXPECT_EQ("boolean[3]", use("boolean", 3).id);
  EXPECT_EQ("Bool_3 array boolean * 3", shown("boolean[3]"));
  EXPECT_EQ("Bus: sensor_t[2]", use("Bus: sensor_t", 2).id);
}

}  // namespace
