/* A gethostname that fails, or fills the caller's room and leaves no terminator. */
#include <errno.h>
#include <stddef.h>
#include <stdlib.h>
#include <string.h>

int gethostname(char* name, size_t length);

__attribute__((visibility("default"))) int gethostname(char* name, size_t length) {
    const char* const how = getenv("REPLACEMENT_HOSTNAME");
    if (how == NULL || strcmp(how, "fails") == 0) {
        errno = EFAULT;
        return -1;
    }
    memset(name, 'h', length);
    return 0;
}
