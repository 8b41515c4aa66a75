#pragma once

/// Marks what libKVbase exports.
#define KVBASE_API __attribute__((visibility("default")))
