#pragma once

/// Marks what libKVpyextInit exports.
#define KVPYEXTINIT_API __attribute__((visibility("default")))
