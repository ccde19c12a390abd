// Numbers that the program shares with its resource script, which knows no C++.
#pragma once

#define IDR_MAIN 100

#define IDM_FILE_OPEN 1001
#define IDM_FILE_EXIT 1002
#define IDM_FILE_SIMULATE 1003
#define IDM_FILE_SIMULATE_OTHER 1004
#define IDM_FILE_RECORD 1005
#define IDM_EXPORT_PICTURE 1006
#define IDM_EXPORT_VALUES 1007
#define IDM_EXPORT_REPORT 1008
#define IDM_EXPORT_WINDOW 1009

/* In the order of the table in panel_kinds.h. */
#define IDM_PANELS_FIRST 1101
#define IDM_PANELS_SPECTRUM 1101
#define IDM_PANELS_PILOTS 1102
#define IDM_PANELS_LAST 1102
#define IDM_PANELS_SIDE_BY_SIDE 1110
#define IDM_PANELS_STACKED 1111
#define IDM_PANELS_NEXT 1112
#define IDM_PANELS_CLOSE 1113
#define IDM_PANELS_MESSAGES 1114
#define IDM_PANELS_CLEAR_MESSAGES 1115
#define IDM_PANELS_PLAYBACK 1116
#define IDM_PANELS_POP_UP 1117

#define IDM_SOURCE_PLAY 1201
#define IDM_SOURCE_PAUSE 1202
#define IDM_SOURCE_STEP 1203
#define IDM_SOURCE_RESTART 1204
#define IDM_SOURCE_STEP_BACK 1205
#define IDM_SOURCE_LOOP 1206
#define IDM_SOURCE_GO_TO 1207

#define IDM_HELP_ABOUT 1301
#define IDM_HELP_KEYS 1302

/* The rates stand in the order of the table in rates.h. */
#define IDM_RATE_FIRST 1401
#define IDM_RATE_LAST 1406

/* What is done once a panel's event is over; in no menu. */
#define IDM_LATER 1501
#define IDM_CANCEL 1502

#define IDM_SETTINGS_SAVE 1601
#define IDM_SETTINGS_RESTORE 1602
#define IDM_IMPORT_CELLS 1603
/* Nine each. */
#define IDM_SAVE_SET_UP_FIRST 1611
#define IDM_SAVE_SET_UP_LAST 1619
#define IDM_RESTORE_SET_UP_FIRST 1621
#define IDM_RESTORE_SET_UP_LAST 1629

/* The host's pop-up menu of a panel: the panel's numbers of the items, from here on. */
#define IDM_POP_UP_FIRST 2000
#define IDM_POP_UP_LAST 3999

#define IDC_CLIENT 4001
#define IDC_TIME_SLIDER 4002
#define IDC_TIME_TEXT 4003
#define IDC_PROGRESS 4004
#define IDC_MESSAGES 4005
#define IDC_STATUS 4006

/* The windows of the panels, as the window system numbers them in the menu. */
#define IDM_FIRST_PANEL_WINDOW 5000
