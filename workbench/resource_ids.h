// Numbers that the program shares with its resource script, which knows no C++.
#pragma once

#define IDR_MAIN 100

#define IDM_FILE_OPEN 1001
#define IDM_FILE_EXIT 1002
#define IDM_PANELS_SPECTRUM 1101
#define IDM_PANELS_CLOSE 1102
#define IDM_SOURCE_PLAY 1201
#define IDM_SOURCE_PAUSE 1202
#define IDM_SOURCE_STEP 1203
#define IDM_SOURCE_RESTART 1204
#define IDM_HELP_ABOUT 1301

/* What is done for a panel once its event is over; in no menu. */
#define IDM_SINGLE_SWEEP 1501
#define IDM_ANSWER_PANEL 1502

/* The rates stand in the order of the table in rates.h. */
#define IDM_RATE_FIRST 1401
#define IDM_RATE_LAST 1406
