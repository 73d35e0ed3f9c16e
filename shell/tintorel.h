/* The C interface between Tintorel hosts and the filter plug-in stillmark.tnf. C99, and C++ as well.
 *
 * A host loads the library, looks EntryFI up and calls it once per phase of a run:
 *
 *   Parameters   only when a dialog may be shown       \
 *   Prepare      the plug-in divides the memory         |  one TNFilterBlock, the same through the run
 *   Start        the whole run happens in this call     |
 *   Continue     may be left out, or come repeatedly    |
 *   Finish       always the last, unless a call failed /
 *   About        at any time, with a TNAboutBlock
 *
 * After a call of Parameters, Prepare or Start that leaves anything but 0 in *result the run is over: the plug-in has
 * forgotten it and Finish has nothing to do.
 *
 * Threads. EntryFI is called on one thread, the host's main thread, one call at a time. The plug-in calls back on that
 * thread only, with one exception that is marked "any thread": the colour space suite.
 *
 * Failure. Functions that return TNError give 0 for success; anything else is a failure and the outputs are undefined.
 * Nothing throws, jumps or unwinds across this interface in either direction.
 *
 * Ownership. Whoever makes a thing owns it. The block and all that it points to are the host's. Tables of functions
 * stay good until the run is over, and suites until they are released; the document, its lists and its channels until
 * the call of EntryFI that shows them returns. Every acquired suite is released once per acquire. Exceptions are
 * marked.
 *
 * Numbers are native. Structures have the compiler's natural layout. Fields are added at the end only, and `size` says
 * how far a structure reaches.
 */
#ifndef STILLMARK_SHELL_TINTOREL_H
#define STILLMARK_SHELL_TINTOREL_H

#include <stddef.h>
#include <stdint.h>

#ifdef __cplusplus
extern "C"
{
#endif

/* A four-character code, the first character in the highest byte. */
#define TN_CODE(a, b, c, d) \
    (((uint32_t)(unsigned char)(a) << 24) | ((uint32_t)(unsigned char)(b) << 16) | \
     ((uint32_t)(unsigned char)(c) << 8) | (uint32_t)(unsigned char)(d))

    /* --- Selectors and results
     * ---------------------------------------------------------------------------------------- */

    enum TNSelector
    {
        TNSelectorAbout = 0,
        TNSelectorParameters = 1,
        TNSelectorPrepare = 2,
        TNSelectorStart = 3,
        TNSelectorContinue = 4,
        TNSelectorFinish = 5
    };

    /* A result word: 0 done; 1 the run has ended and the user has been told, or has cancelled; negative a host error
     * code, which the host tells the user. */
    typedef int16_t TNError;

    enum TNErrorCode
    {
        TNNoError = 0,
        TNUserHasBeenTold = 1,
        TNErrUserCanceled = -128,
        TNErrFreeBlock = -111,
        TNErrNilHandle = -109,
        TNErrMemoryFull = -108,
        TNErrParameter = -50,
        TNErrVolumeLocked = -46,
        TNErrFileLocked = -45,
        TNErrFileNotFound = -43,
        TNErrEndOfFile = -39,
        TNErrInputOutput = -36,
        TNErrDiskFull = -34,
        TNErrOpen = -23,
        TNErrWrite = -20,
        TNErrRead = -19
    };

    /* --- Geometry and image modes
     * ------------------------------------------------------------------------------------- */

    /* right and bottom are exclusive. */
    typedef struct TNRect16
    {
        int16_t left, top, right, bottom;
    } TNRect16;

    typedef struct TNRect32
    {
        int32_t left, top, right, bottom;
    } TNRect32;

    typedef struct TNPoint16
    {
        int16_t x, y;
    } TNPoint16;

    typedef struct TNPoint32
    {
        int32_t x, y;
    } TNPoint32;

    /* 8-bit samples run from 0 to 255, 16-bit samples from 0 to 32768, 32-bit samples are float with 1 for white.
     * CMYK samples are stored with the largest value for no ink; Lab's a and b have their zero in the middle. */
    enum TNImageMode
    {
        TNModeBitmap = 0,
        TNModeGrey = 1,
        TNModeIndexed = 2,
        TNModeRGB = 3,
        TNModeCMYK = 4,
        TNModeHSL = 5,
        TNModeHSB = 6,
        TNModeMultichannel = 7,
        TNModeDuotone = 8,
        TNModeLab = 9,
        TNModeGrey16 = 10,
        TNModeRGB16 = 11,
        TNModeLab16 = 12,
        TNModeCMYK16 = 13,
        TNModeMultichannel16 = 14,
        TNModeDuotone16 = 15,
        TNModeRGB32 = 16,
        TNModeGrey32 = 17
    };

    /* --- Host memory and properties
     * ----------------------------------------------------------------------------------- */

    /* A block of host memory that can be handed over; null is none. */
    typedef struct TNHandleData *TNHandle;

    typedef struct TNHandleProcs
    {
        void *context;                                     /* the first argument of each function, here and below */
        TNHandle (*create)(void *context, uint64_t bytes); /* null when there is no memory; the caller's to dispose */
        void (*dispose)(void *context, TNHandle handle);   /* null is allowed */
        uint64_t (*size)(void *context, TNHandle handle);
        void *(*lock)(void *context, TNHandle handle); /* the bytes, until unlock */
        void (*unlock)(void *context, TNHandle handle);
    } TNHandleProcs;

#define TN_PROPERTY_SIGNATURE TN_CODE('T', 'N', 'D', 'W')

#define TN_PROPERTY_VERSION TN_CODE('v', 'e', 'r', 's')      /* get: major << 16 | minor << 8 | fix */
#define TN_PROPERTY_HIGH_DENSITY TN_CODE('H', 'D', 'P', 'I') /* get: scale mode, 0 to 2 */
#define TN_PROPERTY_BRIGHTNESS TN_CODE('U', 'I', 'B', 'R')   /* get: of the interface, 0 to 3 */
#define TN_PROPERTY_HIGHLIGHT TN_CODE('H', 'L', 'C', 'R')    /* get: 2 for the coloured highlight */
#define TN_PROPERTY_LIGHT_TEXT TN_CODE('L', 'G', 'T', 'B')   /* get: 1 for light title bars */
#define TN_PROPERTY_WINDOW_SCALE TN_CODE('z', 'S', 'c', 'W') /* get: not 0 when windows are to be scaled */
#define TN_PROPERTY_PLAYING TN_CODE('p', 'l', 'i', 'p')      /* get: not 0 while a recorded action is played */
#define TN_PROPERTY_WATCH TN_CODE('w', 't', 'c', 'h')        /* set: 1 suspends the host's wait cursor */

    typedef struct TNPropertyProcs
    {
        void *context;
        /* Writes a number, or a handle of UTF-8 text without end mark that the caller disposes of; the other output is
         * 0 or null. A failure means that the host does not know the key. */
        TNError (*get)(void *context, uint32_t signature, uint32_t key, int32_t index, intptr_t *number,
                       TNHandle *text);
        TNError (*set)(void *context, uint32_t signature, uint32_t key, int32_t index, intptr_t number);
    } TNPropertyProcs;

    /* --- Suites
     * ------------------------------------------------------------------------------------------------------- */

    /* Tables of functions by name and version. A host offers what it has; for the rest acquire fails. */
    typedef struct TNSuiteProcs
    {
        void *context;
        TNError (*acquire)(void *context, const char *name, int32_t version, const void **suite);
        TNError (*release)(void *context, const char *name, int32_t version);
    } TNSuiteProcs;

/* Suites that the plug-in uses; their tables stand below. */
#define TN_CHANNEL_PORTS_SUITE "Tintorel Channel Ports Suite for Plug-ins" /* 3 */
#define TN_BUFFER_SUITE "Tintorel Buffer Suite for Plug-ins"               /* 1 */
#define TN_DESCRIPTOR_SUITE "Tintorel Descriptor Suite for Plug-ins"       /* 5 */
#define TN_COLOR_SPACE_SUITE "Tintorel ColorSpace Suite for Plug-ins"      /* 2 */
/* Suites that it knows by name and takes nothing from. */
#define TN_DIRECT_VIEW_SUITE "Tintorel Direct View Suite for Plug-ins"                 /* 3 */
#define TN_UTILITIES_SUITE "Tintorel Utilities Suite for Plug-ins"                     /* 1 */
#define TN_PALETTE_SUITE "Tintorel Palette Suite for Plug-ins"                         /* 1 */
#define TN_STRING_SUITE "Tintorel String Suite for Plug-ins"                           /* 1 */
#define TN_UNICODE_STRING_SUITE "Tintorel Unicode String Suite for Plug-ins"           /* 1 */
#define TN_UI_HOOKS_SUITE "Tintorel UI Hooks Suite for Plug-ins"                       /* 1, 2, 3, 4 */
#define TN_MOUSE_TRACKING_SUITE "Tintorel Mouse Tracking Suite for Plug-ins"           /* 3, 4 */
#define TN_HELP_SUITE "Tintorel Help Suite for Plug-ins"                               /* 1, 2 */
#define TN_FEATURE_SUITE "Tintorel Feature Suite for Plug-ins"                         /* 1 */
#define TN_BASIC_SCRIPTING_SUITE "Tintorel Basic Scripting Suite for Plug-ins"         /* 3 */
#define TN_REFERENCE_SUITE "Tintorel Reference Suite for Plug-ins"                     /* 3 */
#define TN_DESCRIPTOR_REGISTRY_SUITE "Tintorel Descriptor Registry Suite for Plug-ins" /* 3 */

    /* Where samples lie: columnBits from a sample to its right neighbour, rowBits from a row to the next, both
     * multiples of depth and above 0. The memory is the caller's and holds the whole rectangle. */
    typedef struct TNPixelMemory
    {
        void *data;    /* the sample at (rect.left, rect.top) */
        int32_t depth; /* bits a sample: that of the channel */
        int32_t columnBits;
        int64_t rowBits;
    } TNPixelMemory;

    /* What the host reads and writes a channel by; null when it cannot. */
    typedef struct TNPortData *TNPort;

    /* Version 3. rect is in document coordinates, not empty, and lies within the channel's bounds. */
    typedef struct TNChannelPortsSuite
    {
        void *context;
        TNError (*readPixels)(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *destination);
        TNError (*writePixels)(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *source);
    } TNChannelPortsSuite;

    /* Version 1. */
    typedef struct TNBufferSuite
    {
        void *context;
        void *(*allocate)(void *context, uint64_t bytes); /* null when there is no memory; the caller's to dispose */
        void (*dispose)(void *context, void *buffer);     /* null is allowed */
        uint64_t (*space)(void *context);                 /* bytes that are free; a hint */
    } TNBufferSuite;

    /* Version 2. Any thread. Pixels of four samples, converted in place. 16-bit samples run from 0 to 32768. After a
     * conversion to RGB the fourth sample has no meaning. */
    typedef struct TNColorSpaceSuite
    {
        void *context;
        TNError (*cmykToRgb8)(void *context, uint8_t *quads, uint64_t pixels);
        TNError (*cmykToRgb16)(void *context, uint16_t *quads, uint64_t pixels);
    } TNColorSpaceSuite;

    /* Version 5. Values of several types by four-character key; a key that is put again is overwritten. */
    typedef struct TNDescriptorData *TNDescriptor;

    typedef struct TNDescriptorSuite
    {
        void *context;
        /* A descriptor to be freed by the caller. The handle stays its owner's, who may dispose of it at once. */
        TNError (*fromHandle)(void *context, TNHandle handle, TNDescriptor *descriptor);
        TNError (*create)(void *context, TNDescriptor *descriptor);
        /* A handle that the caller owns; put into the block's descriptor slot it becomes the host's. */
        TNError (*toHandle)(void *context, TNDescriptor descriptor, TNHandle *handle);
        TNError (*free)(void *context, TNDescriptor descriptor);

        TNError (*count)(void *context, TNDescriptor descriptor, uint32_t *keys);
        TNError (*key)(void *context, TNDescriptor descriptor, uint32_t index, uint32_t *key);
        TNError (*getInteger)(void *context, TNDescriptor descriptor, uint32_t key, int32_t *value);
        TNError (*getBoolean)(void *context, TNDescriptor descriptor, uint32_t key, uint8_t *value);
        TNError (*getDataLength)(void *context, TNDescriptor descriptor, uint32_t key, uint64_t *bytes);
        TNError (*getData)(void *context, TNDescriptor descriptor, uint32_t key, void *data); /* the whole of it */

        TNError (*putInteger)(void *context, TNDescriptor descriptor, uint32_t key, int32_t value);
        TNError (*putBoolean)(void *context, TNDescriptor descriptor, uint32_t key, uint8_t value);
        TNError (*putData)(void *context, TNDescriptor descriptor, uint32_t key, uint64_t bytes, const void *data);
    } TNDescriptorSuite;

    /* --- The document
     * ------------------------------------------------------------------------------------------------- */

    /* A channel: a plane of samples over its own rectangle. Lists are linked by next, in the order of the mode's
     * planes. */
    typedef struct TNChannel
    {
        const struct TNChannel *next;
        TNRect32 bounds; /* where it has samples, in document coordinates */
        int32_t depth; /* bits as the host delivers them: 8, 16 or 32; the selection may have 8 in a 16-bit document */
        uint8_t present; /* 0: of the target, and not to be read or written (switched off by the user) */
        TNPort readPort, writePort;
    } TNChannel;

    /* One layer; lists that it does not have are null. */
    typedef struct TNLayer
    {
        const struct TNLayer *next;
        const TNChannel *composite, *transparency, *mask;
    } TNLayer;

    /* version 1: without layers and without targetExtra; 2: layers; 4: targetExtra. Lists that there are not are null.
     */
    typedef struct TNDocument
    {
        int32_t version;
        int32_t depth;    /* bits of the document's samples */
        TNPoint32 size;   /* pixels */
        TNPoint32 origin; /* document coordinates = coordinates of the block's bounds + origin */
        const TNChannel *targetComposite, *targetTransparency, *targetMask;
        const TNChannel *mergedComposite, *mergedTransparency;
        const TNChannel *selection; /* null when all is selected */
        const TNChannel *alpha;
        const TNLayer *layers;
        const TNChannel *targetExtra;
    } TNDocument;

    /* --- What a host shows the user
     * ----------------------------------------------------------------------------------- */

    enum TNAlertKind
    {
        TNAlertOk = 0,
        TNAlertYesNo = 1
    };

    enum TNAlertAnswer
    {
        TNAnswerOk = 1, /* and Yes */
        TNAnswerNo = 2
    };

    /* Texts are UTF-8; second is empty when there is one line only. Functions may be null, and so may the table: then a
     * line on stderr takes the alert's place. */
    typedef struct TNAlertProcs
    {
        void *context;
        int32_t (*show)(void *context, int32_t kind, const char *title, const char *first, const char *second);
        void (*beep)(void *context);
        void (*waitCursor)(void *context, uint8_t on);
    } TNAlertProcs;

    /* --- The blocks
     * --------------------------------------------------------------------------------------------------- */

    typedef struct TNAboutBlock
    {
        uint32_t size; /* sizeof(TNAboutBlock) */
        const TNPropertyProcs *properties;
        const TNSuiteProcs *suites;
        const TNHandleProcs *handles;
        const TNAlertProcs *alerts;
    } TNAboutBlock;

    /* Bounds for pictures beyond 32767 pixels. */
    typedef struct TNBounds32
    {
        uint8_t pluginUses; /* set by the plug-in: it reads the fields here. The host then fills them */
        TNPoint32 imageSize;
        TNRect32 filterRect;
    } TNBounds32;

    /* The recorded action: read at Start when there is one, replaced by the plug-in when a run was recorded. */
    typedef struct TNDescriptorSlot
    {
        TNHandle descriptor; /* the host's, a new one as well; the plug-in does not dispose of the old */
    } TNDescriptorSlot;

    typedef struct TNFilterBlock
    {
        uint32_t size; /* sizeof(TNFilterBlock) */
        int16_t imageMode;

        /* Picture coordinates: what is to be filtered, which is the selection's bounds where there is a selection, else
         * the layer's or the picture's. With numbers that do not fit, 16-bit fields are 0. */
        TNPoint16 imageSize;
        TNRect16 filterRect;
        TNBounds32 *bounds32; /* null in a host that knows 16-bit coordinates only */

        /* Bytes. Prepare finds in maxSpace what the plug-in may have in all and replaces both. */
        int64_t maxSpace;
        int64_t bufferSpace;

        uint8_t autoMask; /* 1: the host blends the result by the selection; cleared by a plug-in that does it itself */

        const TNPropertyProcs *properties;
        const TNSuiteProcs *suites; /* null: no suites */
        const TNHandleProcs *handles;
        const TNAlertProcs *alerts;
        TNDescriptorSlot *descriptor; /* null: no scripting */
        const TNDocument *document;   /* null: there is nothing to read */

        /* The same work as the channel ports suite, for hosts without it; may be null. */
        void *pixelContext;
        TNError (*readPixels)(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *destination);
        TNError (*writePixels)(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *source);

        /* May be null. testAbort: not 0 once the user has asked the run to stop. */
        void *progressContext;
        void (*progress)(void *context, int64_t done, int64_t total);
        uint8_t (*testAbort)(void *context);

        /* Folders for scratch files, the best first; none: the folder for temporary files. UTF-8. */
        const char *const *scratchFolders;
        uint32_t scratchFolderCount;
    } TNFilterBlock;

    /* --- The entry
     * ---------------------------------------------------------------------------------------------------- */

#define TN_ENTRY_NAME "EntryFI"

    /* block: TNAboutBlock for About, TNFilterBlock otherwise. data: a word of the host's for the plug-in; kept, not
     * looked at; may be null. result: always written. A selector that does not exist gives 0. */
    typedef void (*TNEntry)(uint16_t selector, void *block, intptr_t *data, int16_t *result);

#if defined(STILLMARK_BUILDS_PLUGIN)
    __attribute__((visibility("default"))) void EntryFI(uint16_t selector, void *block, intptr_t *data,
                                                        int16_t *result);
#endif

#ifdef __cplusplus
}
#endif

#endif
