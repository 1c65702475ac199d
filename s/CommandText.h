#pragma once

#include "afx.h"

/// A command line with another program and the same arguments. The program ends at the first blank or tab, or, when it
/// begins with a quotation mark, at the next one.
/// @param program  put into quotation marks when it holds blanks or tabs: nothing could start it otherwise
inline CString WithProgram(const CString& command, const CString& program) {
    CString rest = command;
    rest.TrimLeft();
    const int closing = rest.Left(1) == "\"" ? rest.Find('"', 1) : -1;
    const CString behindQuotes = closing > 0 ? rest.Mid(closing + 1) : rest;
    const int blank = behindQuotes.FindOneOf(" \t");
    const CString arguments = blank >= 0 ? behindQuotes.Mid(blank) : CString();
    return (program.FindOneOf(" \t") >= 0 ? "\"" + program + "\"" : program) + arguments;
}
