// Where a run puts its files.

#ifndef HOST_BASE_HX_FILESINK_H
#define HOST_BASE_HX_FILESINK_H

#include <iosfwd>
#include <string>

class HX_FileSink {
 public:
  virtual ~HX_FileSink() = default;
  /// A new file. OWNERSHIP: the stream belongs to the sink.
  virtual std::ostream& open(const std::string& name) = 0;
};

#endif  // HOST_BASE_HX_FILESINK_H
