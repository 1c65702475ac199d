/* Identifiers of the board's resources. */
#define IDR_MAINFRAME 128
#define IDR_BOARDTYPE 129
#define IDR_CONTEXT 130

#define IDD_ABOUT 100
#define IDD_TEXT 101
#define IDD_OUTPUT 102
#define IDC_VERSION 1000
#define IDC_TEXT 1001
#define IDC_OUTPUT 1002
#define IDC_STATE 1003
#define IDC_STOP 1004

#define IDS_CMD_OPCODES 200
#define IDS_USAGE 201
#define IDS_DAMAGED 202
#define IDS_TOO_LARGE 203
#define IDS_VERSION 204
#define IDS_RUN_TITLE 205
#define IDS_RUN_PROMPT 206
#define IDS_NOT_STARTED 207
#define IDS_RUNNING 208
#define IDS_ENDED 209
#define IDS_STOPPED 210
#define IDS_CRASHED 211

/* The tools, in the order of board::Tool. */
#define ID_TOOL_SELECT 32770
#define ID_TOOL_RECTANGLE 32771
#define ID_TOOL_ELLIPSE 32772
#define ID_TOOL_LINE 32773
#define ID_TOOL_TEXT 32774

/* Colours and fills, in the order of the tables in BoardColors.h. */
#define ID_COLOR_FIRST 32780
#define ID_COLOR_LAST 32785
#define ID_FILL_FIRST 32790
#define ID_FILL_LAST 32795

#define ID_SHAPE_EDIT_TEXT 32800
#define ID_SHAPE_TO_FRONT 32801
#define ID_SHAPE_TO_BACK 32802

#define ID_INDICATOR_POSITION 32810

#define ID_TOOLS_RUN_COMMAND 32820
