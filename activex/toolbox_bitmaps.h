// Numbers of the pictures for the toolboxes of designers, for the library's resources and its class table.
#pragma once

#define SPECTRUM_TOOLBOX_BITMAP 101
#define PILOT_TOOLBOX_BITMAP 102
