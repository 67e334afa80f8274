// Prints this build's layout of the host records.
#include "tests/record_layout/record_layout.h"

int main() {
  PrintRecordLayout(stdout);
  return 0;
}
