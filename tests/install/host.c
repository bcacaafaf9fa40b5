/* A host of the installed component: the class by its programmatic name, a form file's grid1, one
 * hourly chart. Exits 0 only when the request succeeds. */
#include <stdio.h>
#include <karstgraph/karstgraph.h>

int main(int argc, char** argv)
{
    KGObject *graph = NULL, *form = NULL;
    KGErrorInfo err = {0};
    KGVariant args[2];
    int32_t hr = argc == 2 ? KGCreateInstanceByProgID(KG_PROGID, &graph) : KG_E_INVALIDARG;
    if (KG_FAILED(hr)) KGGetLastError(&err);
    if (KG_SUCCEEDED(hr)) hr = KGLoadFormFile(argv[1], &form, &err);
    KGVariantInit(&args[0]);
    KGVariantSetObject(&args[0], form);
    if (KG_SUCCEEDED(hr)) hr = KGInvoke(graph, KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT, args, 1, NULL, &err);
    KGVariantClear(&args[0]);
    args[0].vt = KG_VT_I4;
    args[0].lVal = 2;   /* lNumSeries */
    args[1].vt = KG_VT_R8;
    args[1].dblVal = 57; /* vTotal */
    if (KG_SUCCEEDED(hr))
        hr = KGInvoke(graph, KG_DISPID_GENERATECHART_HOURLYGRAPH1, KG_DISPATCH_METHOD, args, 2, NULL, &err);
    if (hr != KG_S_OK)
        fprintf(stderr, "host: status 0x%08X, error %d: %s\n", (unsigned)hr, (int)err.number, err.description);
    KGRelease(form);
    KGRelease(graph);
    return hr == KG_S_OK ? 0 : 1;
}
