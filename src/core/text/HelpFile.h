#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>

// The two help files and their topics. A help file is a sequence of blocks, each ended by a
// line holding only "#"; block n is topic n and its first line is the topic's title.
enum class HelpKind { General, Other };

namespace HelpFile {

// Topics per file: 13 for the general help, 8 for the other help.
int topicCount(HelpKind kind);
// The label that prints the help file and the one that closes the window.
int printIndex(HelpKind kind);
int exitIndex(HelpKind kind);
// The captions of the topic labels, one per topic.
QStringList topicCaptions(HelpKind kind);
// "help.txt" or "HelpOther.txt".
QString fileName(HelpKind kind);

// Splits a help text into exactly `count` topics. Each line of a topic ends with CR LF (empty
// lines too); "#" lines end a block and belong to no topic; text after the last expected block
// is ignored. Lines may end with CR LF, LF or CR. Missing blocks give empty topics; a last block
// that lacks its "#" still keeps its text.
QStringList parseBlocks(const QString& text, int count);

// Help files are plain text: UTF-8 when the bytes are valid UTF-8, Latin-1 otherwise.
QString decode(const QByteArray& bytes);

// Reads the help file of `kind` from `folder`. A missing or unreadable file gives empty topics.
QStringList load(const QString& folder, HelpKind kind);

// The text printed for a help file: the first `count` topics, each followed by three CR LF.
QString composePrintText(const QStringList& topics, int count);

} // namespace HelpFile
