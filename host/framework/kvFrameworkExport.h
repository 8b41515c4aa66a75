#pragma once

/// Marks what libKVframework exports.
#define KVFRAMEWORK_API __attribute__((visibility("default")))
