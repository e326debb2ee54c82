// The data types of a model, as types of a document.
//
//   HX_TypeTable types(rules, dictionary, reserved, notes);
//   HX_TypeUse use = types.resolve({"fixdt(1,16,8)", "double", 1, path});
//   // use.id == "int16", use.lsb == 1.0 / 256

#ifndef HOST_IMPORT_HX_TYPETABLE_H
#define HOST_IMPORT_HX_TYPETABLE_H

#include <deque>
#include <map>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

class HX_Dictionary;
class HX_Notes;
class HX_Rules;
struct HX_DictionaryEntry;

/// Fields as of a type in the document's schema.
struct HX_ImportedType {
  std::string id;
  std::string name;
  std::string kind;
  std::string c;
  std::string cut;
  std::string of;
  int length = 0;
  bool isSigned = true;
  std::vector<std::pair<std::string, std::string>> fields;  // name, type
  std::vector<std::pair<std::string, int>> values;
};

/// A type as written in the model.
struct HX_TypeRequest {
  std::string_view text;
  std::string_view fallback;  ///< the type of the rule
  int elements = 1;
  std::string place;  ///< for notes
};

struct HX_TypeUse {
  std::string id;
  double lsb = 1;
  double zero = 0;
  bool isScalar = true;  ///< a number, or an array of numbers
};

class HX_TypeTable {
 public:
  using Reserved = std::set<std::string, std::less<>>;

  /// \param reserved  words forbidden for types, fields and constants
  HX_TypeTable(const HX_Rules& rules, const HX_Dictionary& dictionary,
               const Reserved& reserved, HX_Notes& notes)
      : m_Rules(rules),
        m_Dictionary(dictionary),
        m_Reserved(reserved),
        m_Notes(notes) {}

  /// Adds the type and the types inside, unless known. An inherited or unknown
  /// type becomes the fallback, with a note; an unknown fallback becomes
  /// double.
  HX_TypeUse resolve(const HX_TypeRequest& request);

  /// Adds the unused enumerations and buses of the dictionary.
  void addDictionary();

  const std::deque<HX_ImportedType>& types() const { return m_Types; }

 private:
  bool resolveScalar(const HX_TypeRequest& request, HX_TypeUse& use);
  bool resolveFixedPoint(std::string_view text, HX_TypeUse& use);
  bool useInteger(int bits, bool isSigned, HX_TypeUse& use);
  bool useBase(std::string_view name, HX_TypeUse& use);
  bool useBus(std::string_view name, HX_TypeUse& use);
  bool useEnumeration(std::string_view name, HX_TypeUse& use);
  bool useAlias(const HX_TypeRequest& request, HX_TypeUse& use);
  void makeArray(int elements, HX_TypeUse& use);
  void addBus(const HX_DictionaryEntry& entry, HX_ImportedType& type);
  void addConstants(const HX_DictionaryEntry& entry, HX_ImportedType& type);
  HX_ImportedType* add(const std::string& id, const std::string& name,
                       const char* kind);
  std::string freeName(const std::string& wanted, Reserved& taken) const;

  const HX_Rules& m_Rules;
  const HX_Dictionary& m_Dictionary;
  const Reserved& m_Reserved;
  HX_Notes& m_Notes;
  std::deque<HX_ImportedType> m_Types;
  std::map<std::string, HX_ImportedType*, std::less<>> m_ById;
  Reserved m_Taken;  // type names and constants share the names of the file
  std::set<std::string, std::less<>> m_OpenBuses;
  int m_Depth = 0;
};

#endif  // HOST_IMPORT_HX_TYPETABLE_H
