#pragma once

/// Marks what libKVpluginAPI exports.
#define KVPLUGINAPI_API __attribute__((visibility("default")))
