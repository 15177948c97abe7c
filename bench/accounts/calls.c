/* accounts_calls: makes the C library's calls that one listing of all users and groups consists of,
 * and nothing else, and prints how many milliseconds they took. */

#include <grp.h>
#include <pwd.h>
#include <shadow.h>
#include <stdio.h>
#include <string.h>
#include <time.h>

static double milliseconds(void)
{
    struct timespec now;
    clock_gettime(CLOCK_MONOTONIC, &now);
    return (double)now.tv_sec * 1e3 + (double)now.tv_nsec / 1e6;
}

static void convertDate(int year, int day)
{
    struct tm date;
    memset(&date, 0, sizeof date);
    date.tm_year = year - 1900;
    date.tm_mday = day;
    date.tm_isdst = -1;
    mktime(&date);
}

static int readLoginRules(void)
{
    char block[4096];
    FILE* const rules = fopen("/etc/pam.d/login", "r");
    if (!rules)
        return 0;
    while (fread(block, 1, sizeof block, rules) == sizeof block)
        ;
    fclose(rules);
    return 1;
}

static int listUsers(void)
{
    char accountLine[4096];
    char ageingLine[4096];
    struct passwd account, *foundAccount;
    struct spwd ageing, *foundAgeing;
    FILE* const accounts = fopen("/etc/passwd", "r");
    FILE* const shadow = fopen("/etc/shadow", "r");
    if (!accounts || !shadow)
        return 0;
    lckpwdf();
    while (!fgetpwent_r(accounts, &account, accountLine, sizeof accountLine, &foundAccount)) {
        fgetspent_r(shadow, &ageing, ageingLine, sizeof ageingLine, &foundAgeing);
        if (!readLoginRules())
            return 0;
        convertDate(1970, 1);
        convertDate(2038, 19);
    }
    ulckpwdf();
    fclose(accounts);
    fclose(shadow);
    return 1;
}

static int listGroups(void)
{
    FILE* const accounts = fopen("/etc/passwd", "r");
    if (!accounts)
        return 0;
    setgrent();
    while (fgetpwent(accounts))
        ;
    while (getgrent())
        ;
    endgrent();
    fclose(accounts);
    return 1;
}

int main(void)
{
    double const start = milliseconds();
    if (!listUsers() || !listGroups())
        return 1;
    printf("%.4f\n", milliseconds() - start);
    return 0;
}
