#pragma once

extern "C" {

/// Receives the lines of the log channel that a process keeps, from any thread, but not those on the logger's own
/// settings. It must not log itself.
struct NVLogWatch {
    void (*take)(void* context, int level, const char* text);
    void* context;
};

/// From now on shows each line to `watch` as well, which must live until another one takes its place; null ends it. For
/// programs that say why something was not done. libnvlog has it under this very name, so that a program can look it up
/// in the library that is loaded already.
void nvLogWatch(const NVLogWatch* watch);

} // extern "C"
