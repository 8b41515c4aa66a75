#pragma once

/// Marks what a library exports; all else is hidden.
#define KV_API __attribute__((visibility("default")))

/// Marks what a library keeps to itself of a class that it exports.
#define KV_LOCAL __attribute__((visibility("hidden")))
