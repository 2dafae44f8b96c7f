#pragma once

#include <QString>

// Reading and writing workspace files. Errors come back as the platform's description.
class WorkspaceFileIO {
public:
    // Reads a whole file and lays it out for the workspace, one delimited field per line.
    static bool readForDisplay(const QString& path, QString& text, QString& error);
    // Writes text to a file. Overwriting goes through a temporary file that replaces the old
    // one only when everything was written, so a failed write leaves the old file whole.
    // Appending adds to the end; when it fails, what the file held before stays.
    static bool write(const QString& path, const QString& text, bool append, QString& error);
};
