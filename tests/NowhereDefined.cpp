// Not part of any library: its link must fail.

void nowhereDefined();
void callNowhereDefined();

void callNowhereDefined()
{
    nowhereDefined();
}
