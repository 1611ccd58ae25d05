@echo off
rem Registers the component: the 32-bit one, and on 64-bit Windows the 64-bit one, too.
rem
rem   register.cmd         for all users of this machine; start it as administrator
rem   register.cmd user    for you alone, which takes no administrator
rem
rem unregister.cmd takes the same word and takes it back.
setlocal
set "here=%~dp0"
set "done=registered"
set "switches=/s"
set "users=all users"
if /i not "%~1"=="undo" goto who
set "done=unregistered"
set "switches=/s /u"
shift /1
:who
if "%~1"=="" goto where
if /i not "%~1"=="user" goto usage
set "switches=%switches% /n /i:user"
set "users=you alone"

:where
rem A 32-bit command prompt on 64-bit Windows sees the 64-bit programs as Sysnative.
set "own=%SystemRoot%\System32"
if defined PROCESSOR_ARCHITEW6432 set "own=%SystemRoot%\Sysnative"
set failed=0
if not exist "%SystemRoot%\SysWOW64\regsvr32.exe" goto bits32
call :one win64 "%own%"
call :one win32 "%SystemRoot%\SysWOW64"
exit /b %failed%
:bits32
call :one win32 "%own%"
exit /b %failed%

:one
"%~2\regsvr32.exe" %switches% "%here%%1\Varnex3.dll"
set status=%errorlevel%
if not %status%==0 goto fault
echo %1\Varnex3.dll is %done% for %users%.
goto :eof
:fault
set failed=1
if %status%==3 goto missing
echo %1\Varnex3.dll could not be %done%: Windows refused the change.
echo Start this again as administrator, or for yourself alone with the word user after its name.
goto :eof
:missing
echo %1\Varnex3.dll could not be %done%: it cannot be loaded.
echo It has to stand beside this file, in the folder %1.
goto :eof

:usage
echo register.cmd, or register.cmd user: the only word it takes is user.
exit /b 2
