#pragma once

/// Marks what libKVresmgt exports.
#define KVRESMGT_API __attribute__((visibility("default")))
