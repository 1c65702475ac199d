/**
 * Identifiers of the library's dialogs, menu, bitmaps and strings. Hosts need those of the commands, which they put
 * into their menus, and those of strings that they show themselves. The range 20000 to 20099 belongs to the library;
 * a host keeps its own identifiers out of it. Only the resource compiler and the preprocessor read this file.
 */
#ifndef GUI_RESOURCE_H
#define GUI_RESOURCE_H

/* Dialogs */
#define GUI_IDD_SPLASH 20000
#define GUI_IDD_ABOUT 20001
#define GUI_IDD_ACCELERATORS 20002
#define GUI_IDD_QUERY 20003
#define GUI_IDD_DIRECTORY 20004
#define GUI_IDD_CONSOLE 20005
#define GUI_IDD_TOPICS 20006
#define GUI_IDD_BROWSER 20007
#define GUI_IDD_PROPERTIES 20008

/* Menu bitmaps, 13 by 12 pixels */
#define GUI_IDB_FLOAT 20011
#define GUI_IDB_DOCK 20012

/* Menu, commands (each with the prompt and tool tip as the string of the same number) and document template */
#define GUI_IDR_CONSOLE 20020
#define GUI_IDM_CONSOLE 20021
#define GUI_ID_HELP_MANUALS 20025
#define GUI_ID_HELP_ABOUT 20026
#define GUI_ID_CONSOLE_COPY 20027
#define GUI_ID_CONSOLE_RUN 20028
#define GUI_ID_HELP_SUPPORT 20099

/* Messages and texts */
#define GUI_IDS_RECALL_ONE_NUMBER 20019
#define GUI_IDS_TUTORIAL_FAILED 20060
#define GUI_IDS_KEY_ASSIGNED 20061
#define GUI_IDS_KEY_OF_MENU 20062
#define GUI_IDS_KEY_UNASSIGNED 20063
#define GUI_IDS_KEY_BEGIN 20064
#define GUI_IDS_KEY_TYPE 20065
#define GUI_IDS_ABOUT_TITLE 20066
#define GUI_IDS_DIRECTORY_MISSING 20067
#define GUI_IDS_DIRECTORY_READ_ONLY 20068
#define GUI_IDS_RECALL_NUMBER_RANGE 20069
#define GUI_IDS_RECALL_PATTERN_PLACE 20070
#define GUI_IDS_RECALL_NO_MATCH 20071
#define GUI_IDS_APP_VERSION 20072
#define GUI_IDS_RELEASE_VERSION 20073
#define GUI_IDS_UNKNOWN_VERSION 20076
#define GUI_IDS_FAMILY_TITLE 20077
#define GUI_IDS_NO_PDF_VIEWER 20078
#define GUI_IDS_BROWSER_TITLE 20079
#define GUI_IDS_DOCK 20081
#define GUI_IDS_BROWSER_FAILED 20083
#define GUI_IDS_BROWSER_SANDBOXED 20084
#define GUI_IDS_BROWSER_FILES_ONLY 20085
#define GUI_IDS_DEFAULT_BROWSER_FAILED 20086
#define GUI_IDS_BROWSER_OTHER_WAY 20087
#define GUI_IDS_NO_DEFAULT_BROWSER 20088
#define GUI_IDS_LAST_BROWSER_FAILED 20089
#define GUI_IDS_NO_LAST_BROWSER 20090
#define GUI_IDS_HELP_PACKAGE_NOT_SET 20091
#define GUI_IDS_HELP_PACKAGE_MISSING 20092
#define GUI_IDS_HELP_NOT_FOUND 20093
#define GUI_IDS_FLOAT_WINDOW 20094
#define GUI_IDS_DOCK_WINDOW 20095
#define GUI_IDS_CLOSE 20096
#define GUI_IDS_ARROW_KEY 20098

/* About box */
#define GUI_IDC_ABOUT_APP_NAME 1020
#define GUI_IDC_ABOUT_APP_VERSION 1022
#define GUI_IDC_ABOUT_ICON 1024
#define GUI_IDC_ABOUT_COPYRIGHT1 1031
#define GUI_IDC_ABOUT_EMPTY 1032
#define GUI_IDC_ABOUT_COPYRIGHT2 1033
#define GUI_IDC_ABOUT_RELEASE 1037

/* Keyboard accelerators */
#define GUI_IDC_ACCEL_REMOVE 1005
#define GUI_IDC_ACCEL_HOTKEY 1013
#define GUI_IDC_ACCEL_ASSIGN 1014
#define GUI_IDC_ACCEL_COMMANDS 1015
#define GUI_IDC_ACCEL_SPECIFY 1017
#define GUI_IDC_ACCEL_COMMAND_TEXT 1018
#define GUI_IDC_ACCEL_KEYS 1019
#define GUI_IDC_ACCEL_KEY_TEXT 1023

/* The Help button of the accelerator and query dialogs */
#define GUI_IDC_HELP_BUTTON 1021

/* Query */
#define GUI_IDC_QUERY_PROMPT 1025
#define GUI_IDC_QUERY_ANSWER 1026

/* Directory */
#define GUI_IDC_DIR_TREE 1030
#define GUI_IDC_DIR_DRIVES 1035
#define GUI_IDC_DIR_NAME 1036

/* Console */
#define GUI_IDC_CONSOLE_LINES 1002
#define GUI_IDC_CONSOLE_PROMPT 1004
#define GUI_IDC_CONSOLE_INPUT 1007
#define GUI_IDC_CONSOLE_SHOW_STATUS 1009

/* Topics found */
#define GUI_IDC_TOPICS 1040

/* Web browser page */
#define GUI_IDC_BROWSER_COMMAND 1041
#define GUI_IDC_BROWSER_LABEL 1042
#define GUI_IDC_BROWSER_SHOW_DEFAULT 1043
#define GUI_IDC_BROWSER_BROWSE 1044
#define GUI_IDC_BROWSER_HINT 1045

/* Properties */
#define GUI_IDC_PROP_TREE 1001
#define GUI_IDC_PROP_TITLE 1003
#define GUI_IDC_PROP_PAGE_FRAME 1005
#define GUI_IDC_PROP_APPLY 6

/* The Help button of the directory and properties dialogs */
#define GUI_IDC_HELP 9

/* Commands of the system menus of floating frames */
#define GUI_ID_FLOAT_WINDOW 1046
#define GUI_ID_DOCK_WINDOW 1047

#endif
