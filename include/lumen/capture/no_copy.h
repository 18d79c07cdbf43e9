// NoCopy: the base of classes that must not be copied (it has no fields).
#pragma once

class NoCopy {
 protected:
  NoCopy() = default;
  ~NoCopy() = default;

 public:
  NoCopy(const NoCopy&) = delete;
  NoCopy& operator=(const NoCopy&) = delete;
};
