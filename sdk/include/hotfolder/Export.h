#pragma once
// Symbols of the default host services library. Everything else is hidden.
#if defined(HF_SDK_BUILDING)
#define HF_SDK_API __attribute__((visibility("default")))
#else
#define HF_SDK_API __attribute__((visibility("default")))
#endif
