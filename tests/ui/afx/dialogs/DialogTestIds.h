#pragma once

#define IDD_SHAPE 100
#define IDD_EMPTY 101
#define IDD_STRANGE 102

#define IDC_NAME 1001
#define IDC_SCALE 1002
#define IDC_LINE 1010
#define IDC_CIRCLE 1011
#define IDC_ARC 1012
#define IDC_VISIBLE 1020
#define IDC_LAYERS 1030
#define IDC_COLOR 1040
#define IDC_FONT 1041
#define IDC_TREE 1050
#define IDC_APPLY 1060
