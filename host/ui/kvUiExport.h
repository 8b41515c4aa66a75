#pragma once

/// Marks what libKVui exports.
#define KVUI_API __attribute__((visibility("default")))
