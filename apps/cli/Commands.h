#pragma once
// The commands of the karstgraph tool. Each takes the arguments that follow its name
// (argv[0] is the first of them) and returns the tool's exit status:
// 0 done, 1 failed, 2 bad usage.

int runDescribe(int argc, char** argv);
int runRegister(int argc, char** argv);
int runUnregister(int argc, char** argv);
// Runs one chart request and writes the chart to an image file.
int runRender(int argc, char** argv);
// Draws every chart of the sample data into a folder, with an index page.
int runGallery(int argc, char** argv);
