#pragma once

/// Marks what libKVpyextGraph exports.
#define KVPYEXTGRAPH_API __attribute__((visibility("default")))
