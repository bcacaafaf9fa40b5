/* KarstGraph: the charting component's C surface.
 *
 * One header for a host written in C (C11, for the anonymous union of KGVariant) or C++. No C++
 * type crosses this boundary: objects are KGObject pointers with a table of functions, values are
 * KGVariant, and every entry point returns a status (KG_S_OK, or a KG_E_* failure).
 *
 * Contents
 *   1. Export macro and status codes
 *   2. Identities: class id, interface ids, programmatic name, dispatch ids
 *   3. Values: KGVariant and KGArray
 *   4. Objects: KGObject, KGErrorInfo, invoking members
 *   5. Class object and the platform's entry points
 *   6. Host extras: creating by programmatic name, test stand options, form files
 *
 * A host in C, start to end:
 *
 *     #include <stdio.h>
 *     #include <karstgraph/karstgraph.h>
 *
 *     int main(void)
 *     {
 *         KGObject* graph = NULL;
 *         KGObject* form = NULL;
 *         KGErrorInfo err;
 *         KGVariant args[2];
 *         int32_t hr;
 *
 *         // needs "karstgraph register" (or DllRegisterServer) once per user
 *         if (KG_FAILED(KGCreateInstanceByProgID(KG_PROGID, &graph))) return 1;
 *         if (KG_FAILED(KGLoadFormFile("report.json", &form, &err))) {
 *             fprintf(stderr, "%s\n", err.description);
 *             return 1;
 *         }
 *
 *         KGVariantInit(&args[0]);
 *         KGVariantSetObject(&args[0], form);           // the variant takes its own reference
 *         hr = KGInvoke(graph, KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT, args, 1, NULL, &err);
 *         KGVariantClear(&args[0]);
 *
 *         KGVariantInit(&args[0]);
 *         args[0].vt = KG_VT_I4;  args[0].lVal = 2;      // lNumSeries
 *         KGVariantInit(&args[1]);
 *         args[1].vt = KG_VT_R8;  args[1].dblVal = 57;   // vTotal
 *         hr = KGInvoke(graph, KG_DISPID_GENERATECHART_HOURLYGRAPH1, KG_DISPATCH_METHOD, args, 2, NULL, &err);
 *         if (hr == KG_E_EXCEPTION) fprintf(stderr, "Error %d: %s\n", (int)err.number, err.description);
 *
 *         KGRelease(form);
 *         KGRelease(graph);
 *         return KG_FAILED(hr) ? 1 : 0;
 *     }
 */
#ifndef KARSTGRAPH_KARSTGRAPH_H
#define KARSTGRAPH_KARSTGRAPH_H

#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

/* ---------------------------------------------------------------------------------------------
 * 1. Export macro and status codes
 * ------------------------------------------------------------------------------------------- */

#if defined(__GNUC__)
#define KG_API __attribute__((visibility("default")))
#else
#define KG_API
#endif

/* Status codes keep the automation platform's values, so a host that knows them reads them as is.
 * Negative values are failures; KG_S_FALSE is a success that answers "no". */
#define KG_S_OK                  ((int32_t)0)
#define KG_S_FALSE               ((int32_t)1)
#define KG_E_FAIL                ((int32_t)0x80004005) /* an unexpected failure; description filled */
#define KG_E_POINTER             ((int32_t)0x80004003) /* a required pointer argument was NULL */
#define KG_E_NOINTERFACE         ((int32_t)0x80004002) /* the class object asked for is not offered */
#define KG_E_OUTOFMEMORY         ((int32_t)0x8007000E)
#define KG_E_INVALIDARG          ((int32_t)0x80070057) /* an argument outside what the call accepts */
#define KG_E_MODNOTFOUND         ((int32_t)0x8007007E) /* the registered library cannot be loaded */
#define KG_E_MEMBERNOTFOUND      ((int32_t)0x80020003) /* no member with that dispatch id and kind */
#define KG_E_TYPEMISMATCH        ((int32_t)0x80020005)
#define KG_E_UNKNOWNNAME         ((int32_t)0x80020006) /* no member with that name */
#define KG_E_BADVARTYPE          ((int32_t)0x80020008) /* a KGVariant with a vt this header does not define */
#define KG_E_EXCEPTION           ((int32_t)0x80020009) /* the member failed: see the KGErrorInfo */
#define KG_E_BADINDEX            ((int32_t)0x8002000B) /* an array index outside its bounds */
#define KG_E_BADPARAMCOUNT       ((int32_t)0x8002000E) /* wrong number of arguments for the member */
#define KG_E_CLASSNOTAVAILABLE   ((int32_t)0x80040111) /* this library does not implement the class */
#define KG_E_CLASSNOTREG         ((int32_t)0x80040154) /* the registration file does not name the class */
#define KG_SELFREG_E_CLASS       ((int32_t)0x80040201) /* the registration file could not be written */

#define KG_SUCCEEDED(status) ((int32_t)(status) >= 0)
#define KG_FAILED(status) ((int32_t)(status) < 0)

/* ---------------------------------------------------------------------------------------------
 * 2. Identities
 * ------------------------------------------------------------------------------------------- */

typedef struct KGGuid {
    uint32_t Data1;
    uint16_t Data2;
    uint16_t Data3;
    uint8_t Data4[8];
} KGGuid;

/* The class cTavixGraph: {6B2E5C1A-4F3D-4E8B-9A7C-2D1F0E3B5A64}. */
static const KGGuid KG_CLSID_cTavixGraph = {0x6B2E5C1A, 0x4F3D, 0x4E8B,
                                            {0x9A, 0x7C, 0x2D, 0x1F, 0x0E, 0x3B, 0x5A, 0x64}};
/* Its default interface _cTavixGraph: {9C4D7E2B-1A5F-4B6C-8D3E-7F0A2C9B4E15}. */
static const KGGuid KG_IID_cTavixGraph = {0x9C4D7E2B, 0x1A5F, 0x4B6C,
                                          {0x8D, 0x3E, 0x7F, 0x0A, 0x2C, 0x9B, 0x4E, 0x15}};
/* The class object's interface (the platform's class factory id). */
static const KGGuid KG_IID_ClassFactory = {0x00000001, 0x0000, 0x0000,
                                           {0xC0, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x46}};

#define KG_PROGID "KarstGraph.cTavixGraph"

/* Members of _cTavixGraph, in slot order. Each returns only its success or failure.
 * SourceForm is a write-only property (KG_DISPATCH_PROPERTYPUT) with one argument, the form object.
 * The requests marked (2) take lNumSeries (KG_VT_I4 or anything that converts to it) and vTotal
 * (any value; Empty means there is nothing to chart); both are read, never written.
 * The others take no arguments. */
#define KG_DISPID_SOURCEFORM                      ((int32_t)0x68030008)
#define KG_DISPID_GENERATECHART_YEARLYRPT1        ((int32_t)0x60030009) /* (2) */
#define KG_DISPID_GENERATECHART_YEARLYRPT2        ((int32_t)0x6003000A) /* (2) */
#define KG_DISPID_GENERATECHART_YEARLYRPT3        ((int32_t)0x6003000B) /* (2) */
#define KG_DISPID_GENERATECHART_BOOKINGSREPORT    ((int32_t)0x6003000C)
#define KG_DISPID_GENERATECHART_SALESDECLARATION  ((int32_t)0x6003000D)
#define KG_DISPID_GENERATECHART_JOBSTATUSREPORT   ((int32_t)0x6003000E)
#define KG_DISPID_GRAPHINITIALIZE                 ((int32_t)0x6003000F)
#define KG_DISPID_GENERATECHART_SERVCATSUMM       ((int32_t)0x60030010)
#define KG_DISPID_GENERATECHART_PROPGRAPH1        ((int32_t)0x60030011) /* (2) */
#define KG_DISPID_GENERATECHART_PROPGRAPH2        ((int32_t)0x60030012) /* (2) */
#define KG_DISPID_GENERATECHART_PROPGRAPH3        ((int32_t)0x60030013) /* (2) */
#define KG_DISPID_GENERATECHART_HOURLYGRAPH1      ((int32_t)0x60030014) /* (2) */
#define KG_DISPID_GENERATECHART_HOURLYGRAPH2      ((int32_t)0x60030015) /* (2) */
#define KG_DISPID_GENERATECHART_HOURLYGRAPH3      ((int32_t)0x60030016) /* (2) */

/* ---------------------------------------------------------------------------------------------
 * 3. Values
 * ------------------------------------------------------------------------------------------- */

/* Type codes of KGVariant.vt. */
#define KG_VT_EMPTY   ((uint16_t)0)
#define KG_VT_NULL    ((uint16_t)1)
#define KG_VT_I2      ((uint16_t)2)      /* iVal */
#define KG_VT_I4      ((uint16_t)3)      /* lVal */
#define KG_VT_R8      ((uint16_t)5)      /* dblVal */
#define KG_VT_DATE    ((uint16_t)7)      /* date: days since 30 Dec 1899, the time as the fraction */
#define KG_VT_STRING  ((uint16_t)8)      /* strVal: UTF-8, NUL-terminated; NULL reads as "" */
#define KG_VT_OBJECT  ((uint16_t)9)      /* objVal: NULL is Nothing */
#define KG_VT_BOOL    ((uint16_t)11)     /* boolVal: -1 true, 0 false */
#define KG_VT_ARRAY   ((uint16_t)0x200C) /* arrVal: a two-dimensional array of variants */

struct KGObject;
typedef struct KGArray KGArray; /* opaque */

/* A variant owns what it holds: its string, one reference to its object, and its array;
 * KGVariantClear frees them. A string is malloc'd memory (KGVariantSetString makes one) and is
 * freed with free(), also when a member writes a result back into a by-reference argument. Start
 * every variant with KGVariantInit; one holding a number may be filled by setting vt and the field. */
typedef struct KGVariant {
    uint16_t vt;
    union {
        int16_t iVal;
        int32_t lVal;
        double dblVal;
        double date;
        int16_t boolVal;
        char* strVal;
        struct KGObject* objVal;
        KGArray* arrVal;
    };
} KGVariant;

KG_API void KGVariantInit(KGVariant* v);
/* Frees what the variant holds and leaves it Empty. */
KG_API void KGVariantClear(KGVariant* v);
/* Clears v and stores a copy of the UTF-8 text (NULL stores ""). */
KG_API int32_t KGVariantSetString(KGVariant* v, const char* utf8);
/* Clears v and stores obj with a reference of its own (NULL stores Nothing). */
KG_API int32_t KGVariantSetObject(KGVariant* v, struct KGObject* obj);
/* Clears dest and stores a copy of src: strings and arrays copied, objects shared (one more reference). */
KG_API int32_t KGVariantCopy(KGVariant* dest, const KGVariant* src);

/* An array lo0..hi0 by lo1..hi1 of Empty cells; NULL when a bound is below its lower bound or the
 * array is too large. Give it to a variant (vt KG_VT_ARRAY, arrVal) or free it with KGArrayDestroy. */
KG_API KGArray* KGArrayCreate(int32_t lo0, int32_t hi0, int32_t lo1, int32_t hi1);
KG_API void KGArrayDestroy(KGArray* a);
/* dim 0 or 1. */
KG_API int32_t KGArrayBounds(const KGArray* a, int dim, int32_t* lower, int32_t* upper);
/* Copies cell (i, j) into out, which is cleared first. KG_E_BADINDEX outside the bounds. */
KG_API int32_t KGArrayGet(const KGArray* a, int32_t i, int32_t j, KGVariant* out);
/* Stores a copy of value into cell (i, j). */
KG_API int32_t KGArrayPut(KGArray* a, int32_t i, int32_t j, const KGVariant* value);

/* ---------------------------------------------------------------------------------------------
 * 4. Objects
 * ------------------------------------------------------------------------------------------- */

/* How a member is invoked; methods and property reads may be combined as callers often do. */
#define KG_DISPATCH_METHOD       ((uint16_t)1)
#define KG_DISPATCH_PROPERTYGET  ((uint16_t)2)
#define KG_DISPATCH_PROPERTYPUT  ((uint16_t)4)
#define KG_DISPATCH_PROPERTYPUTREF ((uint16_t)8)

/* Why a member failed (with KG_E_EXCEPTION, and filled as far as known with the other failures):
 * the error number as the member raised it (for example 91, or 0x80040000 + n for a host's own
 * errors), its description and the name of what raised it. Texts are UTF-8 and always terminated. */
typedef struct KGErrorInfo {
    int32_t number;
    char description[1024];
    char source[128];
} KGErrorInfo;

typedef struct KGObject KGObject;

/* A host may make objects of its own (a form, a grid) by filling this table: the component reaches
 * them exactly as it reaches its own. Names are matched without regard to case. Invoke receives the
 * arguments in declaration order; a member with by-reference parameters writes its results back into
 * args[i] (clearing what was there); result may be NULL when the caller wants none, error may be NULL.
 * A host's Invoke that fails returns KG_E_EXCEPTION with number and description filled (the request
 * that called it then fails with them), or KG_E_MEMBERNOTFOUND, KG_E_BADPARAMCOUNT, KG_E_TYPEMISMATCH
 * (Errors 438, 450, 13), or any other failure status (an error of that number). */
typedef struct KGObjectVtbl {
    uint32_t (*AddRef)(KGObject* self);
    uint32_t (*Release)(KGObject* self);
    int32_t (*GetIDOfName)(KGObject* self, const char* name, int32_t* dispid);
    int32_t (*Invoke)(KGObject* self, int32_t dispid, uint16_t flags, KGVariant* args, uint32_t argc,
                      KGVariant* result, KGErrorInfo* error);
} KGObjectVtbl;

struct KGObject {
    const KGObjectVtbl* vtbl;
};

KG_API uint32_t KGAddRef(KGObject* obj);  /* NULL-safe */
KG_API uint32_t KGRelease(KGObject* obj); /* NULL-safe */
/* KG_E_UNKNOWNNAME when the object has no such member. */
KG_API int32_t KGGetIDOfName(KGObject* obj, const char* name, int32_t* dispid);
/* Checks the pointers and calls the object's Invoke. The component's objects answer:
 *   KG_S_OK               done; by-reference arguments the member changed are written back
 *   KG_E_EXCEPTION        the member failed, however deep: error holds the number and description
 *   KG_E_MEMBERNOTFOUND   no member with this dispatch id, or not invoked as its kind (Error 438)
 *   KG_E_BADPARAMCOUNT    a cTavixGraph member given the wrong number of arguments (Error 450)
 *   KG_E_BADVARTYPE       an argument with a vt this header does not define (Error 458) */
KG_API int32_t KGInvoke(KGObject* obj, int32_t dispid, uint16_t flags, KGVariant* args, uint32_t argc,
                        KGVariant* result, KGErrorInfo* error);
/* GetIDOfName, then Invoke; an unknown name fills error with number 438. */
KG_API int32_t KGInvokeByName(KGObject* obj, const char* name, uint16_t flags, KGVariant* args, uint32_t argc,
                              KGVariant* result, KGErrorInfo* error);

/* ---------------------------------------------------------------------------------------------
 * 5. Class object and the platform's entry points
 * ------------------------------------------------------------------------------------------- */

typedef struct KGClassFactory KGClassFactory;
typedef struct KGClassFactoryVtbl {
    uint32_t (*AddRef)(KGClassFactory* self);
    uint32_t (*Release)(KGClassFactory* self);
    /* A new cTavixGraph, with one reference for the caller. */
    int32_t (*CreateInstance)(KGClassFactory* self, KGObject** out);
    /* Non-zero keeps the library loaded (DllCanUnloadNow answers KG_S_FALSE); zero undoes one lock. */
    int32_t (*LockServer)(KGClassFactory* self, int lock);
} KGClassFactoryVtbl;

struct KGClassFactory {
    const KGClassFactoryVtbl* vtbl;
};

/* The class object of clsid (only KG_CLSID_cTavixGraph). iid may be NULL or KG_IID_ClassFactory.
 * *out receives a KGClassFactory* with one reference. */
KG_API int32_t DllGetClassObject(const KGGuid* clsid, const KGGuid* iid, void** out);
/* KG_S_OK when no object handed out through this surface (class objects included) is alive and no
 * LockServer lock is held; KG_S_FALSE otherwise. Objects the component keeps for itself (the shared
 * state, the chart window) are not counted: the component releases them when it unloads. */
KG_API int32_t DllCanUnloadNow(void);
/* Record and remove the class in the per-user registration file, written atomically:
 * $KARSTGRAPH_REGISTRY, else $XDG_CONFIG_HOME/karstgraph/registry.ini ($XDG_CONFIG_HOME defaults to
 * ~/.config). Other entries of the file are kept. KG_SELFREG_E_CLASS when the file cannot be written
 * (the old file stays as it was); KGGetLastError tells why. */
KG_API int32_t DllRegisterServer(void);
KG_API int32_t DllUnregisterServer(void);

/* ---------------------------------------------------------------------------------------------
 * 6. Host extras
 * ------------------------------------------------------------------------------------------- */

/* A new object of the class registered under progId (matched without regard to case): the
 * registration file gives the class id and the library; the library is loaded when it is not this
 * one, and stays loaded. KG_E_CLASSNOTREG when the file does not name progId, KG_E_MODNOTFOUND when
 * the registered library cannot be loaded. */
KG_API int32_t KGCreateInstanceByProgID(const char* progId, KGObject** out);

/* Options of the test stand, the host objects that this platform's build supplies; they apply to
 * objects created afterwards (each request creates its own). value NULL or "" restores the default.
 *   "settingsFile"      INI file of the settings store (default: the user's karstgraph/settings.ini)
 *   "settingsOwner"     owner text the settings are stored under (default "Tavix")
 *   "appFolder"         the application folder that holds Help/
 *   "eventLogFile"      file that window events are appended to (default: none)
 *   "eventLogToStderr"  "1"/"true"/"yes" or "0"/"false"/"no"
 *   "jobsDatabase"      the job data's database file
 * KG_E_INVALIDARG for an unknown key or an unreadable value. */
KG_API int32_t KGSetHostOption(const char* key, const char* value);

/* The test stand's source form from a JSON form file (grids, date pickers, field lists). *form
 * receives the form with one reference; a missing or malformed file fails with KG_E_EXCEPTION and
 * error names the file and the bad member. */
KG_API int32_t KGLoadFormFile(const char* path, KGObject** form, KGErrorInfo* error);

/* Why the last failing call of this thread that has no KGErrorInfo parameter (DllRegisterServer,
 * DllUnregisterServer, KGCreateInstanceByProgID, KGSetHostOption, DllGetClassObject, CreateInstance,
 * GetIDOfName of the component's objects) failed.
 * KG_S_OK and *out filled when there is one, KG_S_FALSE (and *out cleared) when there is none;
 * reading it forgets it. */
KG_API int32_t KGGetLastError(KGErrorInfo* out);

#ifdef __cplusplus
}
#endif

#endif /* KARSTGRAPH_KARSTGRAPH_H */
