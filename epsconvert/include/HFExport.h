#pragma once
// Marks the few functions the filter module exports; everything else in the
// module is hidden.
#define HF_MODULE_EXPORT extern "C" __attribute__((visibility("default")))
