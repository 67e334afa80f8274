// Ownership of texts and lists the host hands out: each is released with log_free exactly once,
// on every path, as soon as its owner goes out of scope.
#pragma once

#include <memory>
#include <string>

#include "shell/host/qeldll.h"

struct HostFree {
  void operator()(void* memory) const { log_free(memory); }
};

template <typename T>
using HostAllocation = std::unique_ptr<T, HostFree>;

// The host answers null where it has no text; that reads as empty.
inline std::string CopyHostText(const char* text) { return text == nullptr ? std::string() : std::string(text); }
