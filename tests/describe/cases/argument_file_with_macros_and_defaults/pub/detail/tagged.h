// Its own tags win over the defaults. @ZOR2Level L2 @ZOR2Usage U1
// @ZOR2NoAut
#pragma once

struct Tagged {
  /// @ZOR2Retval oMissing
  void Fill(int& oValue);
};
