package android.content;

public class Context {}
