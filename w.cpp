#include "workload.h"
#include <cstdio>
int main(){using namespace vorel_bench; for(auto w:{&line48(),&title160(),&glyph48(),&noise()}){size_t n=0,p=0;for(auto b:w->mask){n+=b==255;p+=b&&b<255;}printf("%s %dx%d glyphs %zu full %.1f%% part %.1f%%\n",w->name.c_str(),w->width,w->height,w->glyphs.size(),100.*n/w->mask.size(),100.*p/w->mask.size());}}
