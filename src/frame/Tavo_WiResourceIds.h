/* The ids of the library's own resources (resources/Tavo_WiResources.rc),
   one definition shared by the resource script and the code. Plain defines,
   so that the resource compiler reads this header as well. */
#pragma once

/* String table: the print header and the print dialog's labels. */
#define TAVO_WI_IDS_PRINT_HEADER 20800 /* "Page %1   [col %2 of %3, row %4 of %5]" */
#define TAVO_WI_IDS_CURRENT_PAGE 20801 /* "C&urrent (Page %1)" */
#define TAVO_WI_IDS_ALL_PAGES 20802    /* "&All (%1col, %2 row)" */
#define TAVO_WI_IDS_PAGE_RANGE 20803   /* "&Pages" */

/* Group cursor: the four-headed arrow of a pan drag, hot spot in the middle. */
#define TAVO_WI_IDC_PAN 20800
