// Symbol export for liblumenutility.so.
//
// The library is built with hidden visibility; only declarations marked LUMEN_API form
// its binary interface.
#pragma once

#define LUMEN_API __attribute__((visibility("default")))
