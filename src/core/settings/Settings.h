#pragma once

#include <QString>

struct AppState;
class Prompts;

// The per-user settings: application "Telvio", section "Settings". Values are text; numbers are
// written as their shortest decimal text so that what was read is written back unchanged.
namespace Settings {

inline constexpr const char* kRetrieveError = "An error occured while retrieving program settings.";
inline constexpr const char* kSaveError = "An error occured while saving program settings.";

// Reads every setting into state. A value that cannot be converted stops the load at that key
// with a message; keys read before keep their new values. A settings file that cannot be parsed
// gives the message too, after every key was read (what the file still holds, else the
// defaults). Returns false after such a failure, true otherwise. Does not run the setup wizard
// (the caller does, when firstRun is reported; it is not reported after a failure). Only a caller
// that passes firstRun has the first start marked done.
bool LoadSettings(AppState& state, Prompts& prompts, bool* firstRun = nullptr);
// Writes all seven settings in their fixed order; a failure stops with a message. A settings
// file that cannot be parsed is first renamed (same folder, ".broken-" and a time stamp added,
// never deleted) and a message says where it went.
bool SaveSettings(AppState& state, Prompts& prompts);
void SetPortName(AppState& state, const QString& name);
// True once: the first-run flag under the executable's base name is read and set to false.
// Throws std::runtime_error when the stored flag is not a boolean.
bool IsFirstRun();
// Creates documentsFolder/"Telvio" when missing; failures are ignored. Returns the folder path.
QString EnsureDataFolder(const QString& documentsFolder);
// True when path names an existing file (a directory does not count).
bool FileExists(const QString& path);

} // namespace Settings
