/* A classic program built against the installed classic headers: no window, only utilities
   and a Pascal-string literal. */
#include <stdio.h>

int main(void)
{
    Str255 text;
    long n = 0;
    StringToNum("\p-42", &n);
    NumToString(n * 2, text);
    printf("%ld %.*s\n", n, text[0], (const char*)text + 1);
    return n == -42 && text[0] == 3 ? 0 : 1;
}
