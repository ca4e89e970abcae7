#pragma once

namespace zor2 {

// What a check is asked to do, as the command line sets it; passed down the
// walk over every document pair, and only read there.
struct CheckSettings {
  // "-L": only files flagged "@ZOR2Level" "L1" are checked, and their level,
  // usage and new pure virtual methods are compared too.
  bool only_flagged_files = false;
  // The release the check is made for ("-level M4R20" gives 20); deprecation
  // exemptions are judged against it.
  int current_level = 99;
};

}  // namespace zor2
