// stdafx.h : include file for standard system include files

#if !defined(AFX_STDAFX_H__4C1D7B21_INCLUDED_)
#define AFX_STDAFX_H__4C1D7B21_INCLUDED_

#if _MSC_VER > 1000
#pragma once
#endif // _MSC_VER > 1000

#define VC_EXTRALEAN        // exclude rarely-used stuff from the system's headers

#include <AfxWin.h>         // core and standard components
#include <afxext.h>         // extensions
#include <afxdisp.h>
#include <afxdtctl.h>
#include <afxcmn.h>         // common controls
#include <afxdlgs.h>
#include <afxcview.h>
#include <afxmt.h>
#include <afxsock.h>
#include <Windows.h>
#include <winuser.h>
#include <CommCtrl.h>
#include <shellapi.h>
#include <shlobj.h>
#include <MMSystem.h>
#include <TChar.h>

#endif // !defined(AFX_STDAFX_H__4C1D7B21_INCLUDED_)
