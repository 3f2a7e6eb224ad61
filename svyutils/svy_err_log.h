#pragma once
// The error log: unexpected internal states are reported with the bare source name ("mathCurves"), a line
// number and (mostly) an empty message. Logging never changes a result. Entries go to the installed sink;
// with none installed they are dropped. Thread-safe: entries may come from any thread.
#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "svyutils/svyutils_export.h"

namespace svy_logging {

struct TErrLogEntry {
  std::string file;
  int line = 0;
  std::string message;
};

using TErrLogSink = std::function<void(const TErrLogEntry&)>;

// Null file or message pointers are logged as empty texts. An exception from the sink is swallowed.
SVYUTILS_API void svy_err_log(const char* file, int line, const char* message) noexcept;

// Installs sink (an empty function removes it) and returns the one it replaces. The sink is called
// outside the log's lock, so it may itself log; it must be safe to call from several threads at once.
SVYUTILS_API TErrLogSink setErrLogSink(TErrLogSink sink);

// Collects the entries logged while it lives (on any thread), then restores the previous sink. Captures
// nest: an inner capture must end before the outer one.
class SVYUTILS_API CScopedErrLogCapture {
 public:
  CScopedErrLogCapture();
  ~CScopedErrLogCapture();
  CScopedErrLogCapture(const CScopedErrLogCapture&) = delete;
  CScopedErrLogCapture& operator=(const CScopedErrLogCapture&) = delete;
  // A copy of the entries captured so far.
  std::vector<TErrLogEntry> entries() const;
  std::size_t count() const;

 private:
  struct State;
  std::shared_ptr<State> state_;  // shared with the installed sink, which may outlive this object briefly
  TErrLogSink previous_;
};

}  // namespace svy_logging
