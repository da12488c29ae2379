// A centroid: a disc with a smooth edge.
varying vec4 v_Colour;
varying vec2 v_UV;

void main()
{
	float inside = 1.0 - smoothstep(0.8, 1.0, length(v_UV));
	gl_FragColor = vec4(v_Colour.rgb, v_Colour.a * inside);
}
