// Tavo_WiPrintLayout: a drawing tiled over a grid of pages.
//
// Pages are numbered from 1, row by row from the top row, each row from left
// to right: page p lies in column (p - 1) mod m_numCols + 1 and row
// (p - 1) div m_numCols + 1. World y grows upwards, so each row lies one box
// height below the one before it, each column one box width right of the one
// before it. Eight 32-bit integers; all 0 until a drawing window lays out a
// print job.
#pragma once

#include "Tavo_GrTypes.h"

struct Tavo_WiPrintLayout {
    int m_numCols = 0;           // page columns of the grid
    int m_numRows = 0;           // page rows of the grid
    int m_currentPage = 0;       // the page that holds the top-left corner of the view
    int m_page = 0;              // the page being printed
    Tavo_GrWRect m_firstPageBox; // the world rectangle printed on page 1, the top-left page
};
