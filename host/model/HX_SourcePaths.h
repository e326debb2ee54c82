// The paths of blocks, chart objects and dictionary objects as people read
// them.
//
// The library sees names in ASCII, see HX_NameText(). Names and paths that
// differ from the text of the document are entered here.

#ifndef HOST_MODEL_HX_SOURCEPATHS_H
#define HOST_MODEL_HX_SOURCEPATHS_H

#include <string>
#include <unordered_map>

class HX_Block;
class HxCSrcRef;

/// The living model has the only object.
class HX_SourcePaths {
 public:
  HX_SourcePaths() { s_Current = this; }
  HX_SourcePaths(const HX_SourcePaths&) = delete;
  HX_SourcePaths& operator=(const HX_SourcePaths&) = delete;
  ~HX_SourcePaths() { s_Current = nullptr; }

  /// Enters the name of the document for a block.
  void enter(const HX_Block* block, const std::string& name) {
    m_Names[block] = name;
  }
  /// Enters the whole path of another source.
  void enter(const HxCSrcRef* source, const std::string& path) {
    m_Paths[source] = path;
  }

  std::string pathOf(const HxCSrcRef* source) const;
  static const HX_SourcePaths* current() { return s_Current; }

 private:
  static HX_SourcePaths* s_Current;

  std::string pathOfBlock(const HX_Block& block) const;

  std::unordered_map<const HX_Block*, std::string> m_Names;
  std::unordered_map<const HxCSrcRef*, std::string> m_Paths;
};

/// The path in the living model, in UTF-8, white space as blanks; empty for
/// null.
std::string HX_PathOf(const HxCSrcRef* source);

#endif  // HOST_MODEL_HX_SOURCEPATHS_H
