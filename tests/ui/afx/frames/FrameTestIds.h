#pragma once

/* Identifiers of the frame tests' resources. */
#define IDR_TESTMAIN 128
#define IDR_TESTBOARD 129
#define IDR_TESTCONTEXT 130
#define IDD_TESTKEYS 131
#define IDC_TEST_TEXT 1001
#define ID_TEST_DRAW 32771
#define ID_TEST_LOCKED 32772
#define ID_TEST_GRID 32773
#define ID_TEST_SMALL 32774
#define ID_TEST_LARGE 32775
#define ID_TEST_ORPHAN 32776
#define ID_TEST_FRAME 32777
#define ID_TEST_APP 32778
#define ID_TEST_DOC 32779
#define ID_INDICATOR_COUNT 32780
