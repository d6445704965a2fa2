// A host that knows only the installed headers and the exported symbols.
#include <Velmar/Velmar.h>

#include <cstdio>

int main()
{
    Rect r{10, 20, 30, 40};
    Velmar::RGBColor c(0x00FF8001u);
    Velmar::Str255 s;
    Velmar::NumToString(-42, s);
    const bool ok = r.bottom == 30 && c.red == 65535 && s[0] == 3 && s[1] == '-';
    std::printf("consumer %s\n", ok ? "ok" : "wrong");
    return ok ? 0 : 1;
}
