' What stands before every script: a stranger's, who calls everything by name and knows nothing beforehand.
Option Explicit

Dim folder, diagnostics, hub
folder = WScript.Arguments(0)
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

Function LastMessage()
  LastMessage = Replace(diagnostics.Message(diagnostics.Count - 1), vbCr, "|")
End Function

