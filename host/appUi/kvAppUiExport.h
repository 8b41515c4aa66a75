#pragma once

/// Marks what libKVappUi exports.
#define KVAPPUI_API __attribute__((visibility("default")))
