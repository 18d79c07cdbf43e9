/** @file */
/// @class NoCopy
/// NoCopy: the base of classes that must not be copied. It has no fields and no behaviour of
/// its own, so it adds nothing to thread-safety or ownership.
#pragma once

class NoCopy {
 protected:
  NoCopy() = default;
  ~NoCopy() = default;

 public:
  NoCopy(const NoCopy&) = delete;
  NoCopy& operator=(const NoCopy&) = delete;
};
