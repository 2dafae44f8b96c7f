#pragma once

class QPrinter;
class QTextDocument;

// Prints a text document page by page with 2 cm margins. Unlike QTextDocument::print, it tells
// whether the printer could be opened and the pages went out, so a missing or failing printer is
// reported instead of passing for success.
bool printDocument(QTextDocument& document, QPrinter& printer);
