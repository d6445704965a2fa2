/* A classic program built against the installed classic headers: no window, only utilities. */
#include <stdio.h>

int main(void)
{
    Str255 text;
    long n = 0;
    NumToString(-42, "\p"[0] == 0 ? text : text);
    StringToNum(text, &n);
    printf("%ld\n", n);
    return n == -42 ? 0 : 1;
}
