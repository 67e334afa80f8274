// A library for the loader's tests to load by name: two exported functions, one with state.
#if defined(_WIN32)
#define PROBE_EXPORT __declspec(dllexport)
#else
#define PROBE_EXPORT __attribute__((visibility("default")))
#endif

extern "C" {

PROBE_EXPORT int ProbeAnswer() { return 42; }

PROBE_EXPORT int ProbeCount() {
  static int count = 0;
  return ++count;
}
}
