// What a camera covers, seen through; it fades towards the far end.
varying vec4 v_Colour;
varying vec2 v_UV;

void main()
{
	gl_FragColor = vec4(v_Colour.rgb, v_Colour.a * (1.0 - v_UV.y));
}
