// Names.h : what the plain names of calls answer

#if !defined(AFX_NAMES_H__4C1D7B33_INCLUDED_)
#define AFX_NAMES_H__4C1D7B33_INCLUDED_

void TellNames(CWnd& wnd, CStringArray& lines);

#endif // !defined(AFX_NAMES_H__4C1D7B33_INCLUDED_)
