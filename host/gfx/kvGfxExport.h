#pragma once

/// Marks what libKVgfx exports.
#define KVGFX_API __attribute__((visibility("default")))
