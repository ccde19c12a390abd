' What stands before every script: a stranger's, who calls everything by name and knows nothing beforehand.
Option Explicit

Dim folder, draws, diagnostics, hub
folder = WScript.Arguments(0)
draws = WScript.Arguments.Count = 1
Set diagnostics = CreateObject("FrontPanels.Diagnostics")
diagnostics.ShowMessages = False
diagnostics.Clear
Set hub = CreateObject("FrontPanels.DataHub.1")

Sub Check(what, actual, expected)
  If CStr(actual) = CStr(expected) Then
    WScript.Echo "ok script: " & what
  Else
    WScript.Echo "not ok script: " & what & ": [" & actual & "], not [" & expected & "]"
  End If
End Sub

' What only a machine that draws can show.
Sub CheckDrawn(what, actual, expected)
  If draws Then Check what, actual, expected
End Sub

Function LastMessage()
  LastMessage = Replace(diagnostics.Message(diagnostics.Count - 1), vbCr, "|")
End Function

