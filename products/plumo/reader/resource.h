#pragma once

#define IDI_PLUMO 1
#define IDR_MENU 10
#define IDR_KEYS 11
#define ID_FILE_OPEN 100
#define ID_FILE_EXIT 101
#define ID_HELP_ABOUT 102
