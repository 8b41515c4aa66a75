#pragma once

/// Marks what libKVpyextUi exports.
#define KVPYEXTUI_API __attribute__((visibility("default")))

/// Marks what libKVpyextUi keeps to itself of a class that it exports.
#define KVPYEXTUI_LOCAL __attribute__((visibility("hidden")))
