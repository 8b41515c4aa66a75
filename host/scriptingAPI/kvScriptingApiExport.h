#pragma once

/// Marks what libKVscriptingAPI exports.
#define KVSCRIPTINGAPI_API __attribute__((visibility("default")))
