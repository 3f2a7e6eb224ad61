#include "svyutils/svy_err_log.h"

#include <mutex>
#include <utility>

namespace svy_logging {
namespace {

// The one installed sink. It is shared, so that a call in progress on another thread keeps the sink it
// started with alive while a new one is installed.
class CSinkSlot {
 public:
  std::shared_ptr<const TErrLogSink> get() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return sink_;
  }
  TErrLogSink exchange(TErrLogSink sink) {
    auto next = sink ? std::make_shared<const TErrLogSink>(std::move(sink)) : nullptr;
    const std::lock_guard<std::mutex> lock(mutex_);
    std::swap(sink_, next);
    return next ? *next : TErrLogSink();
  }

 private:
  mutable std::mutex mutex_;
  std::shared_ptr<const TErrLogSink> sink_;
};

CSinkSlot& sinkSlot() {
  static CSinkSlot slot;
  return slot;
}

}  // namespace

void svy_err_log(const char* file, int line, const char* message) noexcept {
  const auto sink = sinkSlot().get();
  if (!sink) return;
  // Logging never changes a result: a sink that throws (or memory running out) loses the entry only.
  try {
    TErrLogEntry entry;
    entry.file = file != nullptr ? file : "";
    entry.line = line;
    entry.message = message != nullptr ? message : "";
    (*sink)(entry);
  } catch (...) {
    return;
  }
}

TErrLogSink setErrLogSink(TErrLogSink sink) { return sinkSlot().exchange(std::move(sink)); }

struct CScopedErrLogCapture::State {
  mutable std::mutex mutex;
  std::vector<TErrLogEntry> entries;
};

CScopedErrLogCapture::CScopedErrLogCapture() : state_(std::make_shared<State>()) {
  previous_ = setErrLogSink([state = state_](const TErrLogEntry& entry) {
    const std::lock_guard<std::mutex> lock(state->mutex);
    state->entries.push_back(entry);
  });
}

CScopedErrLogCapture::~CScopedErrLogCapture() { setErrLogSink(std::move(previous_)); }

std::vector<TErrLogEntry> CScopedErrLogCapture::entries() const {
  const std::lock_guard<std::mutex> lock(state_->mutex);
  return state_->entries;
}

std::size_t CScopedErrLogCapture::count() const {
  const std::lock_guard<std::mutex> lock(state_->mutex);
  return state_->entries.size();
}

}  // namespace svy_logging
