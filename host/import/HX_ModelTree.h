// The blocks of a model as a tree, references to files expanded.
//
//   HX_ModelTree tree(file, references, limits, notes);
//   for (const HX_ModelBlock& block : tree.root().blocks) ...
//
// Ids are the SIDs of the file. A block inside an expanded reference has the
// id of the referring block and ':' in front; an object of a chart has the id
// of the chart's block and '/' in front. An id stays when blocks come, go, or
// are renamed.

#ifndef HOST_IMPORT_HX_MODELTREE_H
#define HOST_IMPORT_HX_MODELTREE_H

#include <filesystem>
#include <memory>
#include <pugixml.hpp>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "host/import/HX_ChartReader.h"
#include "host/import/HX_ImportError.h"

class HX_ModelFile;
class HX_Notes;
class HX_References;

/// A connected output port.
struct HX_ModelSignal {
  int port;
  std::string label;  ///< no line feeds; may be empty
};

struct HX_ModelBlock {
  std::string id;
  std::string name;       ///< without line feeds
  std::string_view type;  ///< of the linked block where the block is a link
  pugi::xml_node node;
  pugi::xml_node linked;  ///< the block in the library; null for none
  const HX_ModelFile* file = nullptr;  ///< states the defaults
  const HX_ModelBlock* parent = nullptr;
  bool isChart = false;
  bool isFunction = false;  ///< runs as a unit: atomic, triggered, a chart, ...
  bool hasContent = false;
  std::vector<HX_ModelSignal> signals;  ///< by port
  std::vector<HX_ModelBlock> blocks;    ///< by name, numbers by value
  HX_ModelChart chart;

  /// RETURNS: a parameter of the block, of the instance data of a link, of the
  /// linked block, or the default of the file; null for none.
  const char* find(std::string_view parameter) const;
  std::string_view get(std::string_view parameter) const;
  /// Names from the root's down, joined by "/".
  std::string path() const;
};

class HX_ModelTree {
 public:
  /// Throws HX_ImportError for unreadable files and for trees beyond
  /// \p limits. A reference to an absent file adds a note.
  HX_ModelTree(const HX_ModelFile& file, HX_References& references,
               const HX_ImportLimits& limits, HX_Notes& notes);
  HX_ModelTree(const HX_ModelTree&) = delete;
  HX_ModelTree& operator=(const HX_ModelTree&) = delete;

  const HX_ModelBlock& root() const { return m_Root; }

 private:
  // Where in a file the walk is.
  struct Place {
    const HX_ModelFile* file;
    std::string prefix;  // of ids
    std::string path;    // in the file
    int depth;
  };

  void addSystem(pugi::xml_node system, HX_ModelBlock& parent,
                 const Place& place);
  void addBlock(pugi::xml_node node, HX_ModelBlock& block, const Place& place);
  void addContent(HX_ModelBlock& block, pugi::xml_node node,
                  const Place& place);
  void addReferenced(HX_ModelBlock& block, const Place& place,
                     const std::string& name, std::string_view inner);
  void addSignals(pugi::xml_node system, HX_ModelBlock& parent);
  std::string uniqueId(std::string id, const HX_ModelBlock& block);

  HX_References& m_References;
  const HX_ImportLimits& m_Limits;
  HX_Notes& m_Notes;
  std::size_t m_Count = 0;
  std::set<std::string> m_Ids;
  // Files and blocks under expansion, against circles.
  std::vector<std::string> m_Expanding;
  HX_ModelBlock m_Root;
};

#endif  // HOST_IMPORT_HX_MODELTREE_H
