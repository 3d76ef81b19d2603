/* Compiles with -DTYPE=getSi -DRESULT=int -DPARAMETERS="(void* out, int n)", and only then. */

#include <commonprovider/plugin.h>

#define DECLARE(type) CP_FUNCTION(type, checked)

DECLARE(TYPE);

#ifdef __cplusplus
extern "C"
#endif
    RESULT checked PARAMETERS;
