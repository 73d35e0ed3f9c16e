/* What portPlugin.c is told to do, as the number of the property portPluginKey. C and C++. */
#pragma once

#include "shell/tintorel.h"

#define portPluginKey TN_CODE('t', 'o', 'd', 'o')

enum portPluginTask
{
    taskNothing,
    taskInvert,  /* Start inverts the 8-bit samples of the target, using every table and suite that there is, gives all
                  * back, and records the number of samples */
    taskTell,    /* each selector shows an alert: its number, and the bounds that it sees */
    taskAsk,     /* Start asks a Yes/No question; No ends the run with 1 */
    taskLeak,    /* Start gives nothing back */
    taskTwice,   /* Start gives everything back twice */
    taskBadRead, /* reads with an empty rectangle, then with strides that hold no samples */
    taskBadThread, /* reads, and converts a colour, on a thread of its own */
    taskNoResult,
    taskBadHandleRecorded, /* leaves an address that is no handle in the slot */
    taskJunkRecorded,      /* leaves a handle of junk in the slot */
    taskDisposeRecorded,   /* disposes of the action that it was given */
    taskFailAt = 100       /* + selector: -34 there; taskTell else */
};
