#pragma once
// Symbols of the default host services library, the same for the library
// and its users. Everything else is hidden.
#define HF_SDK_API __attribute__((visibility("default")))
