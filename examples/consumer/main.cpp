// Uses the installed library: a word list, printed back.
#include <cstdio>

#include "duduzu/duduzu.h"

static void printWord(FILE* stream, int* word) { fputs(reinterpret_cast<char*>(word), stream); }

int main() {
  char text[] = "installed duduzu works";
  DomList* words = StrToTokenList(text, " ");
  ListPrint(stdout, words, printWord, "+");
  printf("\n");
  ListDelete(&words, ListElemFree);
  return 0;
}
