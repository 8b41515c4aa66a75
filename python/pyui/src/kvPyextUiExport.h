#pragma once

/// Marks what libKVpyextUi exports.
#define KVPYEXTUI_API __attribute__((visibility("default")))
