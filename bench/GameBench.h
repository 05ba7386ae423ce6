#pragma once

// Figures for the computer's two decisions and for whole games played by a
// scripted user against the computer, without a display.
void RunGameBench(int argc, char** argv);
